// The velocity grid of one view during a fast drag: the kernels with their textures and uniforms, ready to run. Every
// pass reads what the pass before it wrote, and the first one reads a field that nothing changes, so that each round
// does the same work.
#pragma once

#include <vector>

#include "reference/forms.h"

struct InkGrid {
    InkGrid(int viewWidth, int viewHeight);

    void solvePressure(const Forms& forms);  // from zero, five passes
    void wholeFrame(const Forms& forms);
    void pack(const Forms& forms) { forms.packing(projected.data(), projected.size(), bytes.data()); }

    int width, height;
    std::vector<vec2> velocity, advected, projected, pushed;
    std::vector<float> divergence, pressure, pressureTemp;
    std::vector<unsigned char> bytes;
    AdvectVelocityTShaderImpl advect;
    ComputeDivergenceTShaderImpl diverge;
    JacobiTShaderImpl relax;
    SubtractGradientTShaderImpl subtract;
    AddVelocityTShaderImpl push;
};
