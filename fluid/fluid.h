// The engine: one object that owns every GL object and every simulation parameter.
//
// All methods run on the host's GL thread with its OpenGL ES 2.0 context current. Nothing is reported back: a
// failure is logged, leaves a GL name of 0 and the call goes on.
#pragma once

#include <GLES2/gl2.h>
#include <android/bitmap.h>

#include "gl/surface.h"

// A point or direction in screen pixels, y upwards.
struct Vector_ {
    float x = 0.0f;
    float y = 0.0f;
};

struct Color_ {
    float r = 0.0f;
    float g = 0.0f;
    float b = 0.0f;
};

class Fluid {
public:
    // Frees the CPU buffers. The GL objects are not deleted: when the library unloads, their context may be gone.
    ~Fluid() = default;

    // Set-up, in this order; again after the context was lost, or for another view. Whatever is there is deleted,
    // with a line in the log that names it, and made anew. Both take the same ink switch.
    void InitializeSetting(int width, int height, bool withInk);
    void InitializeGPU(bool withInk);

    // Make a texture from 32-bit RGBA pixels, `info.width` x `info.height`, rows from the top and without padding.
    // Null pixels leave its content undefined.
    void LoadPortraitBGTextures(AndroidBitmapInfo info, void* pixels);
    void LoadLandscapeBGTextures(AndroidBitmapInfo info, void* pixels);
    void LoadWaterTextures(AndroidBitmapInfo info, void* pixels);

    Surface_ CreateSurface(int width, int height);
    Data_ CreateData(int width, int height);
    void SwapSurfaces(Data_* data);
    // Leaves the framebuffer of `surface` bound.
    void ClearSurface(Surface_ surface, float red, float green, float blue, float alpha);
    // Ends an off-screen pass: texture units 3 to 0 unbound, unit 0 active, framebuffer 0 bound, blending off.
    void ResetState();
    void CreateQuad();
    // Draws the whole target with the program in use. Leaves quadvbo bound and attribute 1 enabled.
    void DrawQuad();

    // Draws the water into the current framebuffer. `positions` and `heightAttribs` hold 3 floats a vertex,
    // `indices` unsigned vertex numbers, `mvp` 16 floats by columns. With ink, the density in Density.Ping divides
    // the colours. Leaves ripple_program in use, v_buf and i_buf bound and texture units 0 to 3 unbound.
    void Ripple_Render(const float* positions, const float* heightAttribs, const short* indices, int positionFloats,
                       int heightFloats, int indexCount, const float* mvp, int meshSizeWidth, int meshSizeHeight,
                       int numDetailsWidth, int numDetailsHeight, float refractiveIndex, float alphaMix,
                       float alphaScale1, float alphaScale2, float fresnelRatio, float specularRatio, float exponent,
                       bool withInk, bool landscape);

    GLuint ripple_program = 0;
    GLuint ripple_vertexShader = 0;
    GLuint ripple_fragmentShader = 0;
    GLuint quadvbo = 0;
    int ScreenWidth = 0;  // view size, pixels
    int ScreenHeight = 0;
    float DensityDissipation = 0.0f;
    float ClearInkValue = 0.0f;  // 1 shows the ink, 0 hides it
    int DragMode = 0;            // -1 tap, 0 slow, 1 medium, 2 fast drag
    GLuint portraitBG = 0;
    GLuint landscapeBG = 0;
    GLuint environment = 0;
    Color_ InkColor;
    GLuint v_buf = 0;
    GLuint h_buf = 0;
    GLuint i_buf = 0;
};

extern Fluid fluid;
