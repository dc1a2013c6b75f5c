// Moves the ink density along the velocity: the CPU form of the GPU's density advection. By contract no frame runs it.
#pragma once

#include "tshader/tshader_core.h"

class AdvectDensityTShaderImpl : public TShaderCore<float> {
public:
    void shaderMain(const vec4& fragCoord, float& out) override;

    Texture<vec2> VelocityTexture;
    Texture<float> SourceTexture;  // density
    vec2 InverseSize = {};         // output pixels to texture coordinates
    float TimeStep = 0.0f;
    float BackwardStepSize = 0.0f;  // factor on the back-trace, away from the touch
    float Dissipation = 0.0f;       // factor on the result
    vec2 Scale = {};                // screen pixels per output pixel
    vec2 center = {};               // touch point, in screen pixels, y up
    int drag = 0;                   // -1 tap, 0 slow, 1 medium, 2 fast drag
};
