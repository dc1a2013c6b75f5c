// The touch and its stroke in the engine's coordinates: screen pixels, y upwards.
#pragma once

#include "fluid/fluid.h"

struct Touch {
    int x, y;
    int dx, dy;  // latest movement
};

// The one place where the engine reads the touch that the native methods store.
Touch latestTouch(const Fluid& engine);

// Whether the point lies more than `margin` pixels away from every edge.
bool isInside(const Fluid& engine, int x, int y, int margin);

// Stores the segment (x0, y0) to (x1, y1), y downwards, as Previous to Current.
void recordStroke(Fluid& engine, float x0, float y0, float x1, float y1);

struct Segment {
    Vector_ normal;  // unit direction, (0, 0) without a length
    float length;    // 1 without a length, so that nothing divides by 0
};

Segment segmentBetween(Vector_ previous, Vector_ current);
