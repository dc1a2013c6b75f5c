// Off-screen render targets.
#pragma once

#include <GLES2/gl2.h>

// No GPU has larger textures, and a driver is known to crash on sizes far beyond its limit instead of refusing them.
constexpr int kLargestSide = 65536;

// An RGBA8 texture, clamped to its edge and filtered linearly, as colour attachment 0 of a framebuffer.
struct Surface_ {
    GLuint FboHandle = 0;
    GLuint TextureHandle = 0;
    int Width = 0;  // texels
    int Height = 0;
};

// A pair to ping-pong between: a pass reads Ping and renders into Pong, then its caller swaps them.
struct Data_ {
    Surface_ Ping;
    Surface_ Pong;
};
