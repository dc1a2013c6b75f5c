// Off-screen render targets. All functions need a current GL context.
#pragma once

#include <GLES2/gl2.h>

// Largest side of a target, texels. No GPU has larger textures, and some drivers crash on sizes far beyond their limit
// instead of reporting an error.
constexpr int kLargestSide = 65536;

// A framebuffer whose colour attachment 0 is an RGBA8 texture, clamped to its edge and filtered linearly.
struct Surface_ {
    GLuint FboHandle = 0;
    GLuint TextureHandle = 0;
    int Width = 0;  // texels
    int Height = 0;
};

// A ping-pong pair: a pass reads Ping and renders into Pong, then its caller swaps them.
struct Data_ {
    Surface_ Ping;
    Surface_ Pong;
};

// Creates a target and clears it to zero. Leaves framebuffer 0 and the texture bound. Logs an incomplete framebuffer
// and still returns it.
Surface_ createSurface(int width, int height);

// Leaves the framebuffer of `surface` bound.
void clearSurface(const Surface_& surface, float red, float green, float blue, float alpha);

// Ends an off-screen pass: unbinds texture units 3 to 0, activates unit 0, binds framebuffer 0 and disables blending.
void resetState();
