// Resets the gestures and the engine to the state after the library is loaded.
#pragma once

#include <new>

#include "fluid/fluid.h"
#include "jni/globals.h"

inline void resetGestures() {
    TouchPressure = 1.0f;
    isMovingEvent = -1;
    state = step = drag_step = count = TOUCH_ACTION = 0;
    POSITION_X = POSITION_Y = PREV_POSITION_X = PREV_POSITION_Y = DX = DY = 0;
    DRAG_START_X = DRAG_START_Y = DRAG_END_X = DRAG_END_Y = 0;
    bWithInk = false;
    SCREEN_WIDTH = SCREEN_HEIGHT = 0;
    fluid.~Fluid();
    new (&fluid) Fluid;
}
