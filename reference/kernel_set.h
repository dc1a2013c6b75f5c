// Several implementations of the library's formulas. Tests compare their results, benchmarks their times.
#pragma once

#include <cstddef>

#include "tshader/AddVelocityTShaderImpl.h"
#include "tshader/AdvectVelocityTShaderImpl.h"
#include "tshader/ComputeDivergenceTShaderImpl.h"
#include "tshader/JacobiTShaderImpl.h"
#include "tshader/SubtractGradientTShaderImpl.h"
#include "water/ripples.h"
#include "water/waves.h"

struct KernelSet {
    const char* name;
    bool (*wave)(float* velocity, float* height, const WaveRegion&, bool checkCalm, float damping, float waveSpeed);
    void (*jacobi)(JacobiTShaderImpl&);
    // The following are null if the set does not implement them.
    void (*ripple)(const RippleField&, float posA, float posB, float amplitude);
    void (*advection)(AdvectVelocityTShaderImpl&);
    void (*forcing)(AddVelocityTShaderImpl&);
    void (*divergence)(ComputeDivergenceTShaderImpl&);
    void (*gradient)(SubtractGradientTShaderImpl&);
    void (*packing)(const vec2* velocity, std::size_t count, unsigned char* rgba);
};

extern const KernelSet kLibrary;
extern const KernelSet kScalar;          // plain loops, automatic vectorization off
extern const KernelSet kAutoVectorized;  // the same loops at -O3
extern const KernelSet kEigen;           // array expressions
