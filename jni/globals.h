// State that the native methods share between calls, with what the engine reads in base/touch_state.h. Positions are
// screen pixels as the host reports them, origin at the top left, y downwards. There is one thread of control, so
// nothing is locked.
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

// Tunable.
extern float TouchPressure;    // weight of the latest touch: pressure^2 + 0.2, or 0 without pressure
extern int Andante_threshold;  // pixels between two touches above which a movement is medium and a tap a drag
extern int Allegro_threshold;  // pixels above which it is fast
extern int acc_step;           // tap frames in which the divergence source grows
extern int sim_step;           // tap frames in which ink is injected
extern int max_step;           // length of a tap, frames
extern int isMovingEvent;      // StrokeKind of the latest drag movement, kTap until there is one

// Gesture and frame.
extern int state;            // GestureState
extern int step;             // frames of the current tap
extern int drag_step;        // frames of the current drag
extern int count;            // ink frames since the last touch-down
extern int PREV_POSITION_X;  // touch before the latest
extern int PREV_POSITION_Y;
extern int DRAG_START_X;  // current drag segment
extern int DRAG_START_Y;
extern int DRAG_END_X;
extern int DRAG_END_Y;
extern int TOUCH_ACTION;  // action code of the latest touch

// Set-up.
extern bool bWithInk;     // fixed by onInitSetting; without ink only the water is simulated and drawn
extern int SCREEN_WIDTH;  // view size given to onInitSetting, the viewport of every frame
extern int SCREEN_HEIGHT;

// The one engine, constructed when the library loads and destroyed when it unloads.
extern Fluid fluid;
