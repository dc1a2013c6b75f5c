#include "fluid/touch_point.h"

#include <cmath>

#include "jni/globals.h"

static bool isInside(const Fluid& engine, int x, int y, int margin) {
    const int up = wrappingDifference(engine.ScreenHeight, y);
    return x > margin && up > margin && x < wrappingDifference(engine.ScreenWidth, margin) &&
           up < wrappingDifference(engine.ScreenHeight, margin);
}

bool Fluid::isBoundary(int x, int y) const {
    return !isInside(*this, x, y, BoundaryMargin);
}

int flippedTouchY(const Fluid& engine) {
    return wrappingDifference(engine.ScreenHeight, POSITION_Y);
}

bool isTouchInside(const Fluid& engine, int margin) {
    return isInside(engine, POSITION_X, POSITION_Y, margin);
}

void recordStroke(Fluid& engine, float x0, float y0, float x1, float y1) {
    const auto height = static_cast<float>(engine.ScreenHeight);
    engine.Current = {x1, height - y1};
    engine.Previous = {x0, height - y0};
}

Segment segmentBetween(Vector_ previous, Vector_ current) {
    const float dx = current.x - previous.x;
    const float dy = current.y - previous.y;
    float length = static_cast<float>(std::sqrt(static_cast<double>(dx * dx + dy * dy)));
    if (length == 0.0f) length = 1.0f;
    return {{dx / length, dy / length}, length};
}
