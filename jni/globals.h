// State that the native methods keep between calls, in addition to base/touch_state.h. Positions are screen pixels,
// origin at the top left, y down. All access is on one thread, without locks.
#pragma once

#include "base/touch_state.h"
#include "fluid/fluid.h"

enum GestureState { kIdle = 0, kTapping = 1, kDragging = 2 };
enum MotionAction {
    kActionDown = 0,
    kActionUp = 1,
    kActionMove = 2,
    kActionCancel = 3
};  // the codes of android.view.MotionEvent

extern float TouchPressure;    // pressure^2 + 0.2 of the latest touch, or 0 if its pressure is 0
extern int Andante_threshold;  // a movement of more pixels between two events is a medium drag and ends a tap
extern int Allegro_threshold;  // a movement of more pixels is a fast drag
extern int acc_step;           // frames of a tap with a divergence source
extern int sim_step;           // frames of a tap with ink injection
extern int max_step;           // length of a tap, frames
extern int isMovingEvent;      // StrokeKind of the latest drag event; kTap before the first

extern int state;            // GestureState
extern int step;             // frames of the current tap
extern int drag_step;        // frames of the current drag
extern int count;            // ink frames since the last touch-down
extern int PREV_POSITION_X;  // previous touch
extern int PREV_POSITION_Y;
extern int DRAG_START_X;  // current drag segment
extern int DRAG_START_Y;
extern int DRAG_END_X;
extern int DRAG_END_Y;
extern int TOUCH_ACTION;  // action code of the latest touch

extern bool bWithInk;     // set by onInitSetting
extern int SCREEN_WIDTH;  // view size from onInitSetting; the viewport of every frame
extern int SCREEN_HEIGHT;

extern Fluid fluid;
