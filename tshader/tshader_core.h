// Base class of the CPU kernels. A kernel is a fragment shader over float textures: its fields are the textures and
// uniforms, shaderMain computes one fragment, and `run`, if the kernel has one, computes the whole output. A kernel
// owns no memory; the output must not alias an input.
//
// The library calls only `run`. Its result differs from shaderMain's by rounding and, by contract, in two places:
// velocity advection and divergence measure the distance to the touch from a texel's corner instead of its centre, and
// Jacobi sets the border of its output to 0.
#pragma once

#include <cstddef>
#include <cstdlib>

#include "tshader/texture.h"
#include "tshader/vec.h"

template <class T>
class TShaderCore {
public:
    virtual ~TShaderCore() = default;

    // Uses malloc, because the C++ runtime's operator new would link the unwinder into a static build.
    static void* operator new(std::size_t size) noexcept { return std::malloc(size); }
    static void* operator new(std::size_t, void* place) noexcept { return place; }
    static void operator delete(void* kernel) { std::free(kernel); }

    // fragCoord.xy is the fragment in output pixels; texel (i, j) has its centre at (i + 0.5, j + 0.5).
    virtual void shaderMain(const vec4& fragCoord, T& out) = 0;

    Texture<T> output;
    char name[100] = {};  // set by contract; the library does not read it
};
