// The touch and its stroke in the engine's coordinates: screen pixels, y up.
#pragma once

#include "fluid/fluid.h"

struct Touch {
    int x, y;
    int dx, dy;  // latest movement
};

// Converts the latest touch of base/touch_state.h.
Touch latestTouch(const Fluid& engine);

// Returns whether the point is more than `margin` pixels away from every edge.
bool isInside(const Fluid& engine, int x, int y, int margin);

// Stores (x0, y0) in Previous and (x1, y1) in Current. The arguments have y down.
void recordStroke(Fluid& engine, float x0, float y0, float x1, float y1);

struct Segment {
    Vector_ normal;  // unit direction; (0, 0) if both ends coincide
    float length;    // 1 if both ends coincide, to avoid a division by 0
};

Segment segmentBetween(Vector_ previous, Vector_ current);
