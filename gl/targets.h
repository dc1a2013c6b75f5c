// Off-screen render targets. Needs the GL context current.
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

// A target cleared to zero. Leaves framebuffer 0 and the texture bound. An incomplete one is logged and returned all
// the same.
Surface_ createSurface(int width, int height);

// Leaves the framebuffer of `surface` bound.
void clearSurface(const Surface_& surface, float red, float green, float blue, float alpha);

// Ends an off-screen pass: texture units 3 to 0 unbound, unit 0 active, framebuffer 0 bound, blending off.
void resetState();
