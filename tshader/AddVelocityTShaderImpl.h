// Adds velocity around the segment of a fast drag, directed away from the segment and towards its end.
#pragma once

#include "tshader/tshader_core.h"

class AddVelocityTShaderImpl : public TShaderCore<vec2> {
public:
    void shaderMain(const vec4& fragCoord, vec2& out) override;
    void run();

    Texture<vec2> Velocity;
    vec2 Scale = {};        // screen pixels per texel
    vec2 InverseSize = {};  // one texel in texture coordinates
    vec2 current = {};      // end of the segment, in screen pixels, y up
    vec2 previous = {};     // start of the segment
    vec2 normal = {};       // unit direction from previous to current
    float len = 0.0f;       // length of the segment; 1 if both ends coincide
    float Radius = 0.0f;    // maximum distance that is pushed, screen pixels
};
