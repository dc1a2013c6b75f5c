// One and the same set of formulas in several forms, so that each can be timed beside the others in one program.
#pragma once

#include <cstddef>

#include "tshader/AddVelocityTShaderImpl.h"
#include "tshader/AdvectVelocityTShaderImpl.h"
#include "tshader/ComputeDivergenceTShaderImpl.h"
#include "tshader/JacobiTShaderImpl.h"
#include "tshader/SubtractGradientTShaderImpl.h"
#include "water/ripples.h"
#include "water/waves.h"

struct Forms {
    const char* name;
    bool (*wave)(float* velocity, float* height, const WaveRegion&, bool checkCalm, float damping, float waveSpeed);
    void (*jacobi)(JacobiTShaderImpl&);
    // The rest is null where a form has none.
    void (*ripple)(const RippleField&, float posA, float posB, float amplitude);
    void (*advection)(AdvectVelocityTShaderImpl&);
    void (*forcing)(AddVelocityTShaderImpl&);
    void (*divergence)(ComputeDivergenceTShaderImpl&);
    void (*gradient)(SubtractGradientTShaderImpl&);
    void (*packing)(const vec2* velocity, std::size_t count, unsigned char* rgba);
};

extern const Forms kLibrary;
extern const Forms kScalar;          // plain loops, automatic vectorization off
extern const Forms kAutoVectorized;  // the same loops at -O3
extern const Forms kEigen;           // array expressions
