#include "jni/ink_frame.h"

#include <algorithm>

#include "jni/globals.h"

namespace {

// Far beyond any digitizer. A source near the end of a float's range would leave a flow of which nothing is a number.
constexpr float kHeaviestTouch = 1.0e30f;

// The renderer divides by the colour, which must not be 0.
Color_ offsetColor(Color_ color) {
    const auto raised = [](float channel) { return static_cast<float>(double{channel} + 0.05); };
    return {raised(color.r), raised(color.g), raised(color.b)};
}

// A blot grows for sim_step frames; its source pushes the water apart for the first acc_step of them. By contract the
// radius of the first frame is 0, and a tap whose finger keeps moving a little does not end.
void stepTap(Color_ color) {
    const float frame = static_cast<float>(step);
    fluid.DragMode = -1;
    fluid.VelocityDissipation = 0.94f;
    fluid.DensityDissipation = 0.92f;
    fluid.Radius = 8.0f * frame;
    fluid.ImpulseDensity = 200.0f;
    fluid.SourceRadius = 40.0f;
    fluid.SourceStrength = step < acc_step ? 12.0f * frame : 0.0f;
    if (step < sim_step) {
        fluid.Inject(
            -1, static_cast<float>(wrappingDifference(POSITION_X, DX)),
            static_cast<float>(wrappingDifference(POSITION_Y, DY)), static_cast<float>(POSITION_X),
            static_cast<float>(POSITION_Y), color);
        fluid.BackwardStepSize = static_cast<float>(0.1 * step);
    }
    countFrame(step);
    if (step > max_step && TOUCH_ACTION != 2) {
        state = 0;
        step = 0;
    }
}

struct DragPreset {
    int dragMode;
    float radius;
    float impulseDensity;
    float sourceStrength;
    float sourceRadius;
    float velocityDissipation;
    float densityDissipation;
};

void apply(const DragPreset& preset) {
    fluid.DragMode = preset.dragMode;
    fluid.Radius = preset.radius;
    fluid.ImpulseDensity = preset.impulseDensity;
    fluid.SourceStrength = preset.sourceStrength;
    fluid.SourceRadius = preset.sourceRadius;
    fluid.VelocityDissipation = preset.velocityDissipation;
    fluid.DensityDissipation = preset.densityDissipation;
}

void stepDrag(Color_ color) {
    DRAG_END_X = POSITION_X;
    DRAG_END_Y = POSITION_Y;
    const auto startX = static_cast<float>(DRAG_START_X);
    const auto startY = static_cast<float>(DRAG_START_Y);
    const auto endX = static_cast<float>(DRAG_END_X);
    const auto endY = static_cast<float>(DRAG_END_Y);
    if (isMovingEvent == 2) {
        apply({2, 30.0f, 40.0f, 20.0f, 4.0f, 0.96f, 0.92f});
        fluid.Perturb(startX, startY, endX, endY);
    } else if (isMovingEvent == 1) {
        apply({1, 25.0f, 150.0f, 10.0f, 20.0f, 0.94f, 0.92f});
    } else if (isMovingEvent == 0) {
        const float weight = std::min(TouchPressure, kHeaviestTouch);
        apply({0, 40.0f * weight, 100.0f, 45.0f * weight, 20.0f, 0.8f, 0.94f});
    }
    fluid.Inject(fluid.DragMode, startX, startY, endX, endY, color);
    countFrame(drag_step);
    // The next frame's segment starts where this one ended.
    DRAG_START_X = DRAG_END_X;
    DRAG_START_Y = DRAG_END_Y;
}

}  // namespace

void stepInk(Color_ hostColor) {
    fluid.InkColorOffset = 0.7f;
    const Color_ color = offsetColor(hostColor);
    fluid.Update(count);  // By contract with the parameters of the last frame.
    count = wrappingDifference(count, -1);
    fluid.BackwardStepSize = 1.0f;
    fluid.InkIntensity = 0.02f;
    fluid.TimeStep = 0.25f;
    if (state == 1) {
        stepTap(color);
    } else if (state == 2) {
        stepDrag(color);
    }
}
