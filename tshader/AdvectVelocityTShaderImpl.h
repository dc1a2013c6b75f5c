// Semi-Lagrangian self-advection of the velocity: each texel traces back along its velocity and samples the source
// there.
#pragma once

#include "tshader/tshader_core.h"

class AdvectVelocityTShaderImpl : public TShaderCore<vec2> {
public:
    void shaderMain(const vec4& fragCoord, vec2& out) override;
    void run();

    Texture<vec2> VelocityTexture;  // gives the back-trace
    Texture<vec2> SourceTexture;    // sampled at its end
    vec2 InverseSize = {};          // one texel in texture coordinates
    vec2 Scale = {};                // screen pixels per texel
    float TimeStep = 0.0f;          // texels per unit of velocity
    float Dissipation = 0.0f;       // factor on the result
    vec2 center = {};               // touch point, in screen pixels, y up
    vec2 delta = {};                // latest movement of the touch, y up
    int drag = 0;                   // -1 tap, 0 slow, 1 medium, 2 fast drag
};
