#include "jni/ink_frame.h"

#include <limits>

#include "base/wrapping.h"
#include "fluid/ink_tuning.h"
#include "jni/globals.h"

namespace {

// Counts a frame of a gesture, which may be held for as long as a finger has patience.
void countFrame(int& frames) {
    if (frames < std::numeric_limits<int>::max()) ++frames;
}

// Whether the last set-up had memory for the flow. Without it nothing would carry ink away, so none is injected.
bool hasFlow() {
    return fluid.VelocityTex.data != nullptr;
}

// The renderer divides by the colour, which must not be 0.
Color_ offsetColor(Color_ color) {
    const auto raised = [](float channel) { return static_cast<float>(double{channel} + kColorRaise); };
    return {raised(color.r), raised(color.g), raised(color.b)};
}

// A blot grows for sim_step frames; its source pushes the water apart for the first acc_step of them. By contract the
// radius of the first frame is 0, and a tap whose finger keeps moving a little does not end.
void stepTap(Color_ color) {
    const float frame = static_cast<float>(step);
    InkPreset preset = kTapPreset;
    preset.radius *= frame;
    preset.sourceStrength *= step < acc_step ? frame : 0.0f;
    fluid.apply(preset);
    if (step < sim_step) {
        if (hasFlow()) {
            fluid.Inject(
                kTap, static_cast<float>(wrappingDifference(POSITION_X, DX)),
                static_cast<float>(wrappingDifference(POSITION_Y, DY)), static_cast<float>(POSITION_X),
                static_cast<float>(POSITION_Y), color);
        }
        fluid.BackwardStepSize = kTapBackwardStep * frame;
    }
    countFrame(step);
    if (step > max_step && TOUCH_ACTION != kActionMove) {
        state = kIdle;
        step = 0;
    }
}

void stepDrag(Color_ color) {
    DRAG_END_X = POSITION_X;
    DRAG_END_Y = POSITION_Y;
    const auto startX = static_cast<float>(DRAG_START_X);
    const auto startY = static_cast<float>(DRAG_START_Y);
    const auto endX = static_cast<float>(DRAG_END_X);
    const auto endY = static_cast<float>(DRAG_END_Y);
    if (isMovingEvent == kFastDrag) {
        fluid.apply(kFastPreset);
        fluid.Perturb(startX, startY, endX, endY);
    } else if (isMovingEvent == kMediumDrag) {
        fluid.apply(kMediumPreset);
    } else if (isMovingEvent == kSlowDrag) {
        InkPreset preset = kSlowPreset;
        preset.radius *= TouchPressure;
        preset.sourceStrength *= TouchPressure;
        fluid.apply(preset);
    }
    if (hasFlow()) fluid.Inject(fluid.DragMode, startX, startY, endX, endY, color);
    countFrame(drag_step);
    // The next frame's segment starts where this one ended.
    DRAG_START_X = DRAG_END_X;
    DRAG_START_Y = DRAG_END_Y;
}

}  // namespace

void stepInk(Color_ hostColor) {
    fluid.InkColorOffset = kInkColorOffset;
    const Color_ color = offsetColor(hostColor);
    if (hasFlow()) {
        fluid.Update(count);  // By contract with the parameters of the last frame.
    } else {
        // A set-up leaves the ink's framebuffer bound, which the water must not draw into.
        fluid.ResetState();
    }
    count = wrappingDifference(count, -1);
    fluid.BackwardStepSize = kBackwardStep;
    fluid.InkIntensity = kInkIntensity;
    fluid.TimeStep = kTimeStep;
    if (state == kTapping) {
        stepTap(color);
    } else if (state == kDragging) {
        stepDrag(color);
    }
}
