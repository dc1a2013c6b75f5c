// Adds ink around the touch or along the last drag segment. CPU version of fluid/add_ink.frag; by contract only tests
// run it.
#pragma once

#include "tshader/tshader_core.h"

class AddInkTShaderImpl : public TShaderCore<float> {
public:
    void shaderMain(const vec4& fragCoord, float& out) override;

    Texture<float> Source;        // density
    vec2 Scale = {};              // screen pixels per output pixel
    vec2 InverseSize = {};        // output pixels to texture coordinates
    vec2 current = {};            // touch point or end of the segment, in screen pixels, y up
    vec2 previous = {};           // start of the segment
    vec2 normal = {};             // unit direction from previous to current
    int mode = 0;                 // 2 along the segment, otherwise around current
    float len = 0.0f;             // length of the segment
    float ImpulseDensity = 0.0f;  // ink at the centre
    float Radius = 0.0f;          // maximum distance that receives ink, screen pixels
};
