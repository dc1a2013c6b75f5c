// Pebbles painted one over the other, as they lie on the bed of a river.
#pragma once

#include <vector>

#include "preview/noise.h"

struct Rgb {
    float r, g, b;  // linear light, 1 is white
};

// Rows from the top.
struct Canvas {
    int width, height;
    std::vector<Rgb> pixels;
};

// Covers the canvas with pebbles; `unit` is the radius of a middling one in pixels.
void scatterPebbles(Canvas& canvas, float unit, Random& random, const CloudTile& clouds);
