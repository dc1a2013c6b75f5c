// The velocity grid of a view during a fast drag: the kernels with their textures and uniforms set. The first pass
// reads `velocity`, which no pass writes; every other pass reads the result of the one before. Each frame therefore
// does the same work.
#pragma once

#include <vector>

#include "reference/kernel_set.h"

struct InkGrid {
    InkGrid(int viewWidth, int viewHeight);

    void solvePressure(const KernelSet& kernels);  // five iterations from a pressure of 0
    void wholeFrame(const KernelSet& kernels);
    void pack(const KernelSet& kernels) { kernels.packing(projected.data(), projected.size(), bytes.data()); }

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
