#pragma once

#include <cstddef>

#include "tshader/vec.h"

// Packs velocities for the GPU's velocity texture, one RGBA8 texel each. R and G hold x, B and A hold y. A component is
// clamped to -127 ... 127 and 127 is added; the first byte is the integer part, the second the fraction times 255.
void packVelocity(const vec2* velocity, std::size_t count, unsigned char* rgba);
