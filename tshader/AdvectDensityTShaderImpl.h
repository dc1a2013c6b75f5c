// Advects the ink density along the velocity. CPU version of fluid/advect_density.frag; by contract only tests run it.
#pragma once

#include "tshader/tshader_core.h"

class AdvectDensityTShaderImpl : public TShaderCore<float> {
public:
    void shaderMain(const vec4& fragCoord, float& out) override;

    Texture<vec2> VelocityTexture;
    Texture<float> SourceTexture;  // density
    vec2 InverseSize = {};         // output pixels to texture coordinates
    float TimeStep = 0.0f;
    float BackwardStepSize = 0.0f;  // scale of the back-trace, 80 pixels and more away from the touch
    float Dissipation = 0.0f;       // factor on the result
    vec2 Scale = {};                // screen pixels per output pixel
    vec2 center = {};               // touch point, in screen pixels, y up
    int drag = 0;                   // -1 tap, 0 slow, 1 medium, 2 fast drag
};
