#include "jni/ink_frame.h"

#include <limits>

#include "base/wrapping.h"
#include "fluid/ink_tuning.h"
#include "jni/globals.h"

namespace {

// Increments without overflow, because a gesture has no maximum duration.
void countFrame(int& frames) {
    if (frames < std::numeric_limits<int>::max()) ++frames;
}

// Returns whether the set-up could allocate the velocity field. Without it ink would not move or fade, so none is
// added.
bool hasFlow() {
    return fluid.VelocityTex.data != nullptr;
}

// The renderer divides by each channel, so 0 must not occur.
Color_ offsetColor(Color_ color) {
    const auto raised = [](float channel) { return static_cast<float>(double{channel} + kColorRaise); };
    return {raised(color.r), raised(color.g), raised(color.b)};
}

// Injects ink for sim_step frames with a growing radius. The divergence source acts during the first acc_step of them.
// By contract the radius of the first frame is 0, and a tap does not end while its latest event is a move.
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
    DRAG_START_X = DRAG_END_X;
    DRAG_START_Y = DRAG_END_Y;
}

}  // namespace

void stepInk(Color_ hostColor) {
    fluid.InkColorOffset = kInkColorOffset;
    const Color_ color = offsetColor(hostColor);
    if (hasFlow()) {
        fluid.Update(count);  // By contract uses the parameters of the previous frame.
    } else {
        fluid.ResetState();  // Unbinds the ink's framebuffer, which the set-up leaves bound.
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
