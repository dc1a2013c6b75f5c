// One Jacobi iteration of the pressure equation.
#pragma once

#include "tshader/tshader_core.h"

class JacobiTShaderImpl : public TShaderCore<float> {
public:
    void shaderMain(const vec4& fragCoord, float& out) override;

    // Computes the interior; by contract sets the border of the output to 0.
    void run();

    Texture<float> Pressure;
    Texture<float> Divergence;
    float Alpha = 0.0f;        // weight of the divergence
    float InverseBeta = 0.0f;  // 1 / number of neighbours
    vec2 InverseSize = {};     // one texel in texture coordinates
};
