#include "tshader/AdvectDensityTShaderImpl.h"

#include <cmath>

void AdvectDensityTShaderImpl::shaderMain(const vec4& fragCoord, float& out) {
    const vec2 fragment = Vec2(fragCoord.x, fragCoord.y);
    const vec2 u = texture2DLinear(VelocityTexture, InverseSize * fragment);
    float step = BackwardStepSize;
    if (drag < 2) {
        // Within 80 pixels the step is proportional to the distance, so ink under a resting finger stays.
        vec2 p = Scale * fragment;
        const float squared = distanceNoSqrt(center, p);
        if (squared < 80.0f * 80.0f) step = static_cast<float>(std::sqrt(squared) * 0.0075);
    }
    out = Dissipation * texture2DLinear(SourceTexture, InverseSize * (fragment - (step * TimeStep) * u));
}
