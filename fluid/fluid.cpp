#include "fluid/fluid.h"

#include <utility>

#include "base/log.h"
#include "fluid/buffers.h"
#include "fluid/ink_tuning.h"
#include "gl/picture_texture.h"
#include "gl/quad.h"
#include "water/renderer.h"

Fluid::~Fluid() {
    freeBuffers(*this);
}

void Fluid::apply(const InkPreset& preset) {
    DragMode = preset.dragMode;
    Radius = preset.radius;
    ImpulseDensity = preset.impulseDensity;
    SourceStrength = preset.sourceStrength;
    SourceRadius = preset.sourceRadius;
    VelocityDissipation = preset.velocityDissipation;
    DensityDissipation = preset.densityDissipation;
}

Surface_ Fluid::CreateSurface(int width, int height) {
    return createSurface(width, height);
}

Data_ Fluid::CreateData(int width, int height) {
    const Surface_ ping = createSurface(width, height);
    return {ping, createSurface(width, height)};
}

void Fluid::SwapSurfaces(Data_* data) {
    std::swap(data->Ping, data->Pong);
}

void Fluid::ClearSurface(Surface_ surface, float red, float green, float blue, float alpha) {
    clearSurface(surface, red, green, blue, alpha);
}

void Fluid::ResetState() {
    resetState();
}

void Fluid::CreateQuad() {
    LOG_INFO("CreateQuad");
    deleteGroup(glObjects(), kQuadBuffer);
    glGenBuffers(1, &quadvbo);
}

void Fluid::DrawQuad() {
    drawQuad(quadvbo);
}

void Fluid::LoadPortraitBGTextures(AndroidBitmapInfo info, void* pixels) {
    LOG_INFO("LoadPortraitBGTextures");
    deleteGroup(glObjects(), kPortraitTexture);
    makePictureTexture(portraitBG, info, pixels);
}

void Fluid::LoadLandscapeBGTextures(AndroidBitmapInfo info, void* pixels) {
    LOG_INFO("LoadLandscapeBGTextures");
    deleteGroup(glObjects(), kLandscapeTexture);
    makePictureTexture(landscapeBG, info, pixels);
}

// By contract logs nothing.
void Fluid::LoadWaterTextures(AndroidBitmapInfo info, void* pixels) {
    deleteGroup(glObjects(), kEnvironmentTexture);
    makePictureTexture(environment, info, pixels);
}

void Fluid::Ripple_Render(
    const float* positions, const float* heightAttribs, const short* indices, int positionFloats, int heightFloats,
    int indexCount, const float* mvp, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth, int numDetailsHeight,
    float refractiveIndex, float alphaMix, float alphaScale1, float alphaScale2, float fresnelRatio,
    float specularRatio, float exponent, bool withInk, bool landscape) {
    const double a = 1.5 - double{InkColorOffset};
    const auto tint = [a](float channel) { return static_cast<float>(a / double{channel} - 1.0); };
    const WaterInk ink = {
        .density = Density.Ping.TextureHandle,
        .tint = {tint(InkColor.r), tint(InkColor.g), tint(InkColor.b)},
        .intensity = InkIntensity * ClearInkValue};
    drawWater(
        {.program = ripple_program,
         .positions = v_buf,
         .heights = h_buf,
         .indices = i_buf,
         .background = landscape ? landscapeBG : portraitBG,
         .light = environment},
        ScreenWidth, ScreenHeight,
        {.positions = positions,
         .heightAttribs = heightAttribs,
         .indices = indices,
         .positionFloats = positionFloats,
         .heightFloats = heightFloats,
         .indexCount = indexCount,
         .mvp = mvp,
         .sizeWidth = meshSizeWidth,
         .sizeHeight = meshSizeHeight,
         .detailsWidth = numDetailsWidth,
         .detailsHeight = numDetailsHeight},
        {.refractiveIndex = refractiveIndex,
         .alphaMix = alphaMix,
         .alphaScale1 = alphaScale1,
         .alphaScale2 = alphaScale2,
         .fresnelRatio = fresnelRatio,
         .specularRatio = specularRatio,
         .exponent = exponent},
        withInk ? &ink : nullptr);
}
