// The engine: one object that owns every GL object and every simulation parameter.
//
// All methods run on the host's GL thread with its OpenGL ES 2.0 context current. Nothing is reported back: a
// failure is logged, leaves a GL name of 0 and the call goes on.
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

// A point or direction in screen pixels, y upwards.
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
    // Frees the CPU buffers. The GL objects are not deleted: when the library unloads, their context may be gone.
    ~Fluid();

    // Set-up, in this order; again after the context was lost, or for another view. Whatever is there is deleted, with
    // a line in the log that names it, and made anew. Both take the same ink switch. With ink, InitializeGPU leaves the
    // framebuffer of Density.Pong bound, the viewport at the ink's size, the clear colour 0 and the blend function set.
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

    // One step of the ink simulation, with the parameters that the last frame left: moves the velocity field on the
    // CPU, uploads it, and carries the ink along it on the GPU. `frame` is not read. Draws two numbers of lrand48 when
    // the touch lies inside the margin. Needs the CPU buffers. Leaves the viewport at the ink's size and framebuffer 0
    // bound.
    void Update(int frame);
    // Adds ink along the segment (x1, y1) to (x2, y2), screen pixels with y downwards: mode 2 a band, any other a disc
    // at its end. Only records the stroke while the touch lies within BoundaryMargin of an edge.
    void Inject(int mode, float x1, float y1, float x2, float y2, Color_ color);
    // Pushes the velocity away from the segment and along it; the same margin holds.
    void Perturb(float x0, float y0, float x1, float y1);
    // Whether the screen point, y downwards, lies within BoundaryMargin pixels of an edge.
    bool isBoundary(int x, int y) const;

    // The two passes over the ink density, from `source` into `destination`. The caller swaps the pair, and sets the
    // viewport for the first one.
    void AdvectDensity(Surface_ velocitySurface, Surface_ source, Surface_ destination, float dissipation);
    void AddInk(Surface_ source, Surface_ destination, int mode, Vector_ previous, Vector_ current, float impulse);

    // The passes over the velocity field; `dest` is none of the inputs, and the caller swaps. See the kernels.
    void AdvectVelocity(Texture<vec2> velocity, Texture<vec2> source, Texture<vec2> dest, float dissipation);
    void AddVelocity(Texture<vec2> velocity, Texture<vec2> dest, Vector_ previous, Vector_ current);
    void ComputeDivergence(Texture<vec2> velocity, Texture<float> dest, Vector_ point);
    void Jacobi(Texture<float> pressure, Texture<float> divergence, Texture<float> dest);
    void SubtractGradient(Texture<vec2> velocity, Texture<float> pressure, Texture<vec2> dest);

    // Takes over what a gesture of one kind writes.
    void apply(const InkPreset& preset);

    // Draws the water into the current framebuffer, which is 0 after Update. `positions` and `heightAttribs` hold 3
    // floats a vertex, `indices` unsigned vertex numbers, `mvp` 16 floats by columns. With ink, the density in
    // Density.Ping divides the colours. Leaves ripple_program in use, v_buf and i_buf bound and texture units 0 to 3
    // unbound.
    void Ripple_Render(
        const float* positions, const float* heightAttribs, const short* indices, int positionFloats, int heightFloats,
        int indexCount, const float* mvp, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
        int numDetailsHeight, float refractiveIndex, float alphaMix, float alphaScale1, float alphaScale2,
        float fresnelRatio, float specularRatio, float exponent, bool withInk, bool landscape);

    Data_ Velocity;  // by contract only Ping is made: the CPU's velocity, packed anew in every frame
    Data_ Density;   // the ink, two bytes a value
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
    float Radius = 0.0f;          // of ink and velocity injections, pixels
    float ImpulseDensity = 0.0f;  // ink of one injection
    int NumJacobiIterations = 0;
    float TimeStep = 0.0f;
    float GradientScale = 0.0f;
    float VelocityDissipation = 0.0f;  // factors at each advection
    float DensityDissipation = 0.0f;
    float SourceStrength = 0.0f;  // taken from the divergence within SourceRadius pixels of the touch
    float SourceRadius = 0.0f;
    float BackwardStepSize = 0.0f;  // back-trace of the density, 1 for the whole way
    float InkColorOffset = 0.0f;
    float ClearInkValue = 0.0f;  // 1 shows the ink, 0 hides it
    float InkIntensity = 0.0f;   // darkening per unit of density
    int DragMode = 0;            // -1 tap, 0 slow, 1 medium, 2 fast drag
    int BoundaryMargin = 0;      // pixels along the edges where nothing is injected
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
    // Owned blocks of GridWidth x GridHeight texels. A pass reads the first of a pair and writes the other, then the
    // two records are swapped.
    Texture<vec2> VelocityTex;
    Texture<vec2> VelocityTexTemp;
    Texture<float> PressureTex;
    Texture<float> PressureTexTemp;
    Texture<float> DivergenceTex;

    // Every GL object that a member names, in groups that are deleted together.
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
