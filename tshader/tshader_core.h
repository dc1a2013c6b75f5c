// The base of the CPU kernels. A kernel is a fragment shader over float textures: its fields are the textures
// and uniforms, shaderMain computes one fragment, and `run`, where a kernel has one, fills the output.
// A kernel owns nothing; output must be another buffer than every input.
//
// The library calls `run` only. It computes what shaderMain does, but for rounding and for two differences that stand
// by contract: velocity advection and divergence lay the disc around the touch over the texels' corners, not their
// centres, and Jacobi sets the border of its output to 0.
#pragma once

#include <cstddef>
#include <cstdlib>

#include "tshader/texture.h"
#include "tshader/vec.h"

template <class T>
class TShaderCore {
public:
    virtual ~TShaderCore() = default;

    // The C allocator: where the C++ runtime is linked statically, its own would bring the unwinder along.
    static void* operator new(std::size_t size) noexcept { return std::malloc(size); }
    static void* operator new(std::size_t, void* place) noexcept { return place; }
    static void operator delete(void* kernel) { std::free(kernel); }

    // fragCoord.xy is the fragment in output pixels; texel (i, j) has its centre at (i + 0.5, j + 0.5).
    virtual void shaderMain(const vec4& fragCoord, T& out) = 0;

    Texture<T> output;
    char name[100] = {};  // by contract, though nothing reads it
};
