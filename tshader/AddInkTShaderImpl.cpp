#include "tshader/AddInkTShaderImpl.h"

#include <cmath>

void AddInkTShaderImpl::shaderMain(const vec4& fragCoord, float& out) {
    const vec2 fragment = Vec2(fragCoord.x, fragCoord.y);
    vec2 p = Scale * fragment;
    out = texture2D(Source, fragment * InverseSize);
    if (mode == 2) {
        vec2 ahead = p - previous;
        const float t = dot(normal, ahead);
        if (t > 0.0f && t < len) {
            vec2 foot = previous + t * normal;
            const float squared = distanceNoSqrt(foot, p);
            if (squared < Radius * Radius) {
                out = static_cast<float>(out + std::exp(-squared / (0.8 * Radius * Radius)) * ImpulseDensity);
            }
        }
    } else {
        const float squared = distanceNoSqrt(current, p);
        if (squared < Radius * Radius) {
            out = static_cast<float>(out + ImpulseDensity / (std::sqrt(static_cast<double>(squared)) + 1.0));
        }
    }
}
