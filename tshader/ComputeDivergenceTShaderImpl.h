// Computes the divergence of the velocity. In a disc around the touch it subtracts SourceStrength, so that the pressure
// solve drives the flow out of the disc.
#pragma once

#include "tshader/tshader_core.h"

class ComputeDivergenceTShaderImpl : public TShaderCore<float> {
public:
    void shaderMain(const vec4& fragCoord, float& out) override;
    void run();

    Texture<vec2> Velocity;
    vec2 Scale = {};        // screen pixels per texel
    vec2 InverseSize = {};  // one texel in texture coordinates
    float HalfInvCellSize = 0.0f;
    float SourceStrength = 0.0f;
    float SourceRadius = 0.0f;  // of the disc, in screen pixels
    vec2 center = {};           // of the disc, in screen pixels, y up
};
