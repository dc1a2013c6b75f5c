// Subtracts the pressure gradient from the velocity.
#pragma once

#include "tshader/tshader_core.h"

class SubtractGradientTShaderImpl : public TShaderCore<vec2> {
public:
    void shaderMain(const vec4& fragCoord, vec2& out) override;
    void run();

    Texture<vec2> Velocity;
    Texture<float> Pressure;
    vec2 InverseSize = {};  // one texel in texture coordinates
    float GradientScale = 0.0f;
};
