#include "jni/gesture.h"

#include <cmath>

#include "base/wrapping.h"
#include "fluid/ink_tuning.h"
#include "jni/globals.h"

namespace {

// Stores the movement since the previous touch in DX and DY and returns its length in pixels. dx^2 + dy^2 wraps like
// Java's int, so a movement of more than 46,340 pixels may get any speed class.
float measureMovement(int x, int y) {
    DX = wrappingDifference(x, PREV_POSITION_X);
    DY = wrappingDifference(y, PREV_POSITION_Y);
    const unsigned dx = static_cast<unsigned>(DX);
    const unsigned dy = static_cast<unsigned>(DY);
    return static_cast<float>(std::sqrt(static_cast<double>(static_cast<int>(dx * dx + dy * dy))));
}

void reset() {
    fluid.ClearInkValue = 0.0f;
    state = kIdle;
    step = 0;
}

void startSegment(int x, int y) {
    DRAG_START_X = DRAG_END_X = x;
    DRAG_START_Y = DRAG_END_Y = y;
}

void touchWhileIdle(int x, int y, int action) {
    if (action != kActionDown) return;
    startSegment(x, y);
    state = kTapping;
}

void touchWhileTapping(int x, int y, int action) {
    if (action == kActionDown) {
        step = 1;
        startSegment(x, y);
    } else if (action == kActionMove) {
        const float distance = measureMovement(x, y);
        if (step >= max_step || distance > static_cast<float>(Andante_threshold)) {
            drag_step = 0;
            state = kDragging;  // By contract the first frame has the speed class of the previous drag.
        }
    }
}

void touchWhileDragging(int x, int y, int action) {
    const float distance = measureMovement(x, y);
    isMovingEvent = distance > static_cast<float>(Allegro_threshold)   ? kFastDrag
                    : distance > static_cast<float>(Andante_threshold) ? kMediumDrag
                                                                       : kSlowDrag;
    if (action != kActionUp) return;
    if (step < max_step && drag_step <= 9) {
        // The drag was too short: continue as the tap that it began as.
        state = kTapping;
        return;
    }
    step = 0;
    drag_step = 0;
    fluid.SourceStrength = 0.0f;
    fluid.VelocityDissipation = kReleasedVelocityDissipation;
    fluid.DensityDissipation = kReleasedDensityDissipation;
    state = kIdle;
}

}  // namespace

void touch(int x, int y, int action, float pressure) {
    if (action == kActionDown) count = 0;
    // By contract a pressure of 0 makes a slow drag without ink.
    const double p = pressure;
    TouchPressure = p > 0.0 ? static_cast<float>(p * p + static_cast<double>(0.2f)) : 0.0f;
    POSITION_X = x;
    POSITION_Y = y;
    fluid.ClearInkValue = 1.0f;
    TOUCH_ACTION = action;

    const int entryState = state;
    if (entryState == kIdle) touchWhileIdle(x, y, action);
    if (entryState == kTapping) touchWhileTapping(x, y, action);
    if (entryState == kDragging) touchWhileDragging(x, y, action);
    if (action == kActionCancel) reset();

    PREV_POSITION_X = x;
    PREV_POSITION_Y = y;
}
