// The engine: one object that owns every GL object and every simulation parameter.
//
// Call all methods on the host's GL thread with its OpenGL ES 2.0 context current. They report no errors to the caller:
// a method logs a failure, leaves a GL name of 0 and continues.
#pragma once

#include <GLES2/gl2.h>
#include <android/bitmap.h>

#include <array>

#include "gl/objects.h"
#include "gl/targets.h"
#include "tshader/AddInkTShaderImpl.h"
#include "tshader/AddVelocityTShaderImpl.h"
#include "tshader/AdvectDensityTShaderImpl.h"
#include "tshader/AdvectVelocityTShaderImpl.h"
#include "tshader/ComputeDivergenceTShaderImpl.h"
#include "tshader/JacobiTShaderImpl.h"
#include "tshader/SubtractGradientTShaderImpl.h"
#include "tshader/texture.h"

// A point or direction in screen pixels, y up.
struct Vector_ {
    float x = 0.0f;
    float y = 0.0f;
};

struct InkPreset;

struct Color_ {
    float r = 0.0f;
    float g = 0.0f;
    float b = 0.0f;
};

class Fluid {
public:
    Fluid() = default;
    Fluid(const Fluid&) = delete;
    Fluid& operator=(const Fluid&) = delete;
    // Frees the CPU buffers. Does not delete GL objects: when the library unloads, their context may no longer exist.
    ~Fluid();

    // Set up the engine. Call both in this order with the same `withInk`, and again after a context loss or for another
    // view. Each deletes and logs the objects that it is about to create again. With ink, InitializeGPU leaves the
    // framebuffer of Density.Pong bound, the viewport at the ink's size, the clear colour 0 and the blend function set.
    void InitializeSetting(int width, int height, bool withInk);
    void InitializeGPU(bool withInk);

    // Create a texture from RGBA8 pixels; see makePictureTexture.
    void LoadPortraitBGTextures(AndroidBitmapInfo info, void* pixels);
    void LoadLandscapeBGTextures(AndroidBitmapInfo info, void* pixels);
    void LoadWaterTextures(AndroidBitmapInfo info, void* pixels);

    Surface_ CreateSurface(int width, int height);
    Data_ CreateData(int width, int height);
    void SwapSurfaces(Data_* data);
    // Leaves the framebuffer of `surface` bound.
    void ClearSurface(Surface_ surface, float red, float green, float blue, float alpha);
    void ResetState();
    void CreateQuad();
    void DrawQuad();

    // Steps the ink simulation: advects and projects the velocity field on the CPU, uploads it, and advects the density
    // on the GPU. Uses the parameters set by the previous frame. Calls lrand48 twice if the touch is inside the margin.
    // `frame` is ignored. Requires the CPU buffers. Leaves the viewport at the ink's size and framebuffer 0 bound.
    void Update(int frame);
    // Adds ink in a band along the segment (x1, y1) to (x2, y2) if `mode` is 2, otherwise in a disc around its end. If
    // the touch is within BoundaryMargin of an edge, only records the segment. Screen pixels, y down.
    void Inject(int mode, float x1, float y1, float x2, float y2, Color_ color);
    // Adds velocity around the segment, with the same margin and coordinates as Inject.
    void Perturb(float x0, float y0, float x1, float y1);
    // Returns whether the screen point, y down, is within BoundaryMargin pixels of an edge.
    bool isBoundary(int x, int y) const;

    // Passes over the density, from `source` into `destination`. The caller swaps the pair. AdvectDensity uses the
    // current viewport, AddInk sets the ink's.
    void AdvectDensity(Surface_ velocitySurface, Surface_ source, Surface_ destination, float dissipation);
    void AddInk(Surface_ source, Surface_ destination, int mode, Vector_ previous, Vector_ current, float impulse);

    // Passes over the velocity field; see the kernels. `dest` must not be an input. The caller swaps the pair.
    void AdvectVelocity(Texture<vec2> velocity, Texture<vec2> source, Texture<vec2> dest, float dissipation);
    void AddVelocity(Texture<vec2> velocity, Texture<vec2> dest, Vector_ previous, Vector_ current);
    void ComputeDivergence(Texture<vec2> velocity, Texture<float> dest, Vector_ point);
    void Jacobi(Texture<float> pressure, Texture<float> divergence, Texture<float> dest);
    void SubtractGradient(Texture<vec2> velocity, Texture<float> pressure, Texture<vec2> dest);

    // Copies a gesture preset into the simulation parameters.
    void apply(const InkPreset& preset);

    // Draws the water; see drawWater. With ink, the density in Density.Ping divides the colours.
    void Ripple_Render(
        const float* positions, const float* heightAttribs, const short* indices, int positionFloats, int heightFloats,
        int indexCount, const float* mvp, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
        int numDetailsHeight, float refractiveIndex, float alphaMix, float alphaScale1, float alphaScale2,
        float fresnelRatio, float specularRatio, float exponent, bool withInk, bool landscape);

    Data_ Velocity;  // by contract only Ping exists: the CPU's velocity, packed and uploaded in every frame
    Data_ Density;   // ink, two bytes per value
    GLuint ripple_program = 0;
    GLuint ripple_vertexShader = 0;
    GLuint ripple_fragmentShader = 0;
    GLuint advect_density_program = 0;
    GLuint advect_density_vertexShader = 0;
    GLuint advect_density_fragmentShader = 0;
    GLuint addInk_program = 0;
    GLuint addInk_vertexShader = 0;
    GLuint addInk_fragmentShader = 0;
    GLuint quadvbo = 0;
    float CellSize = 0.0f;
    int ScreenWidth = 0;  // view, pixels
    int ScreenHeight = 0;
    int GridWidth = 0;  // velocity grid, cells of 12 x 12 pixels
    int GridHeight = 0;
    int InkWidth = 0;  // density targets, texels
    int InkHeight = 0;
    float Radius = 0.0f;          // of injected ink and velocity, pixels
    float ImpulseDensity = 0.0f;  // density added by one injection
    int NumJacobiIterations = 0;
    float TimeStep = 0.0f;
    float GradientScale = 0.0f;
    float VelocityDissipation = 0.0f;  // factor per step
    float DensityDissipation = 0.0f;   // factor per step
    float SourceStrength = 0.0f;       // subtracted from the divergence within SourceRadius of the touch
    float SourceRadius = 0.0f;         // pixels
    float BackwardStepSize = 0.0f;     // scale of the density's back-trace
    float InkColorOffset = 0.0f;
    float ClearInkValue = 0.0f;  // 1 shows the ink, 0 hides it
    float InkIntensity = 0.0f;   // darkening per unit of density
    int DragMode = 0;            // -1 tap, 0 slow, 1 medium, 2 fast drag
    int BoundaryMargin = 0;      // width of the border without injection, pixels
    GLuint portraitBG = 0;
    GLuint landscapeBG = 0;
    GLuint environment = 0;
    Vector_ Current;  // end and start of the latest injection
    Vector_ Previous;
    Color_ InkColor;
    GLuint v_buf = 0;
    GLuint h_buf = 0;
    GLuint i_buf = 0;
    AdvectVelocityTShaderImpl AdvectVelocityKernel;
    AdvectDensityTShaderImpl AdvectDensityKernel;
    JacobiTShaderImpl JacobiKernel;
    SubtractGradientTShaderImpl SubtractGradientKernel;
    ComputeDivergenceTShaderImpl ComputeDivergenceKernel;
    AddInkTShaderImpl AddInkKernel;
    AddVelocityTShaderImpl AddVelocityKernel;
    // Owned blocks of GridWidth x GridHeight texels. A pass reads one of a pair and writes its Temp, then they are
    // swapped.
    Texture<vec2> VelocityTex;
    Texture<vec2> VelocityTexTemp;
    Texture<float> PressureTex;
    Texture<float> PressureTexTemp;
    Texture<float> DivergenceTex;

    // Lists every GL object of the engine.
    std::array<GlObject, 22> glObjects() {
        using enum GlKind;
        return {
            {{kRippleProgram, shader, &ripple_vertexShader},
             {kRippleProgram, shader, &ripple_fragmentShader},
             {kRippleProgram, program, &ripple_program},
             {kAdvectDensityProgram, shader, &advect_density_vertexShader},
             {kAdvectDensityProgram, shader, &advect_density_fragmentShader},
             {kAdvectDensityProgram, program, &advect_density_program},
             {kAddInkProgram, shader, &addInk_vertexShader},
             {kAddInkProgram, shader, &addInk_fragmentShader},
             {kAddInkProgram, program, &addInk_program},
             {kVelocityTarget, framebuffer, &Velocity.Ping.FboHandle},
             {kVelocityTarget, texture, &Velocity.Ping.TextureHandle},
             {kDensityTargets, framebuffer, &Density.Ping.FboHandle},
             {kDensityTargets, texture, &Density.Ping.TextureHandle},
             {kDensityTargets, framebuffer, &Density.Pong.FboHandle},
             {kDensityTargets, texture, &Density.Pong.TextureHandle},
             {kQuadBuffer, buffer, &quadvbo},
             {kPositionBuffer, buffer, &v_buf},
             {kHeightBuffer, buffer, &h_buf},
             {kIndexBuffer, buffer, &i_buf},
             {kPortraitTexture, texture, &portraitBG},
             {kLandscapeTexture, texture, &landscapeBG},
             {kEnvironmentTexture, texture, &environment}}};
    }
};
