// Packs velocities for the GPU's velocity texture.
#pragma once

#include <cstddef>

#include "tshader/vec.h"

// Writes one RGBA texel of four bytes per velocity. R and G hold the x component, B and A the y component, each
// clamped to -127 ... 127 and raised by 127: the first byte is the whole part, the second the fraction times 255.
void packVelocity(const vec2* velocity, std::size_t count, unsigned char* rgba);
