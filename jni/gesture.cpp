#include "jni/gesture.h"

#include <cmath>

#include "fluid/fluid.h"
#include "jni/globals.h"

namespace {

enum Action { kDown = 0, kUp = 1, kMove = 2, kCancel = 3 };

// Measures the movement since the last touch and returns its length in pixels. The squares wrap around like Java's
// int; a movement too long for them counts as slow or is sorted by what is left, and either is harmless.
float measureMovement(int x, int y) {
    DX = wrappingDifference(x, PREV_POSITION_X);
    DY = wrappingDifference(y, PREV_POSITION_Y);
    const unsigned dx = static_cast<unsigned>(DX);
    const unsigned dy = static_cast<unsigned>(DY);
    return static_cast<float>(std::sqrt(static_cast<double>(static_cast<int>(dx * dx + dy * dy))));
}

void reset() {
    fluid.ClearInkValue = 0.0f;
    state = 0;
    step = 0;
}

void startSegment(int x, int y) {
    DRAG_START_X = DRAG_END_X = x;
    DRAG_START_Y = DRAG_END_Y = y;
}

void touchWhileIdle(int x, int y, int action) {
    if (action != kDown) return;
    startSegment(x, y);
    state = 1;
}

void touchWhileTapping(int x, int y, int action) {
    if (action == kDown) {
        step = 1;
        startSegment(x, y);
    } else if (action == kMove) {
        const float distance = measureMovement(x, y);
        if (step >= max_step || distance > static_cast<float>(Andante_threshold)) {
            drag_step = 0;
            state = 2;  // By contract its first frame is of the speed class of the drag before.
        }
    }
}

void touchWhileDragging(int x, int y, int action) {
    const float distance = measureMovement(x, y);
    isMovingEvent = distance > static_cast<float>(Allegro_threshold)   ? 2
                    : distance > static_cast<float>(Andante_threshold) ? 1
                                                                       : 0;
    if (action != kUp) return;
    if (step < max_step && drag_step <= 9) {
        // Hardly a drag: it goes on as the tap that it came from.
        state = 1;
        return;
    }
    step = 0;
    drag_step = 0;
    fluid.SourceStrength = 0.0f;
    fluid.VelocityDissipation = 0.9f;
    fluid.DensityDissipation = 0.9f;
    state = 0;
}

}  // namespace

void touch(int x, int y, int action, float pressure) {
    if (action == kDown) count = 0;
    const double p = pressure;
    // By contract no pressure makes a slow drag without ink.
    TouchPressure = p > 0.0 ? static_cast<float>(p * p + static_cast<double>(0.2f)) : 0.0f;
    POSITION_X = x;
    POSITION_Y = y;
    fluid.ClearInkValue = 1.0f;
    TOUCH_ACTION = action;

    const int entryState = state;
    if (entryState == 0) touchWhileIdle(x, y, action);
    if (entryState == 1) touchWhileTapping(x, y, action);
    if (entryState == 2) touchWhileDragging(x, y, action);
    if (action == kCancel) reset();

    PREV_POSITION_X = x;
    PREV_POSITION_Y = y;
}
