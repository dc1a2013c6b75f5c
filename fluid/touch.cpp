#include "fluid/touch.h"

#include <cmath>
#include <utility>

#include "base/flush_denormals.h"
#include "base/touch_state.h"
#include "base/wrapping.h"

Touch latestTouch(const Fluid& engine) {
    return {POSITION_X, wrappingDifference(engine.ScreenHeight, POSITION_Y), DX, wrappingDifference(0, DY)};
}

bool isInside(const Fluid& engine, int x, int y, int margin) {
    return x > margin && y > margin && x < wrappingDifference(engine.ScreenWidth, margin) &&
           y < wrappingDifference(engine.ScreenHeight, margin);
}

bool Fluid::isBoundary(int x, int y) const {
    return !isInside(*this, x, wrappingDifference(ScreenHeight, y), BoundaryMargin);
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

void Fluid::Inject(int mode, float x1, float y1, float x2, float y2, Color_ color) {
    recordStroke(*this, x1, y1, x2, y2);
    InkColor = color;
    const Touch touch = latestTouch(*this);
    if (!isInside(*this, touch.x, touch.y, BoundaryMargin)) return;
    AddInk(Density.Ping, Density.Pong, mode, Previous, Current, ImpulseDensity);
    SwapSurfaces(&Density);
}

void Fluid::Perturb(float x0, float y0, float x1, float y1) {
    recordStroke(*this, x0, y0, x1, y1);
    const Touch touch = latestTouch(*this);
    if (!isInside(*this, touch.x, touch.y, BoundaryMargin)) return;
    const FlushDenormals flush;
    AddVelocity(VelocityTex, VelocityTexTemp, Previous, Current);
    std::swap(VelocityTex, VelocityTexTemp);
}
