// The touch and its stroke in the engine's coordinates: screen pixels, y upwards.
#pragma once

#include "fluid/fluid.h"

// y of the latest touch.
int flippedTouchY(const Fluid& engine);

// Whether the touch lies more than `margin` pixels away from every edge.
bool isTouchInside(const Fluid& engine, int margin);

// Stores the segment (x0, y0) to (x1, y1), y downwards, as Previous to Current.
void recordStroke(Fluid& engine, float x0, float y0, float x1, float y1);

struct Segment {
    Vector_ normal;  // unit direction, (0, 0) without a length
    float length;    // 1 without a length, so that nothing divides by 0
};

Segment segmentBetween(Vector_ previous, Vector_ current);
