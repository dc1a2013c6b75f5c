// State that the native methods share between calls. Positions are screen pixels as the host reports them, origin at
// the top left, y downwards. There is one thread of control, so nothing is locked.
#pragma once

#include <limits>

// Tunable.
extern float TouchPressure;    // weight of the latest touch: pressure^2 + 0.2, or 0 without pressure
extern int Andante_threshold;  // pixels between two touches above which a movement is medium and a tap a drag
extern int Allegro_threshold;  // pixels above which it is fast
extern int acc_step;           // tap frames in which the divergence source grows
extern int sim_step;           // tap frames in which ink is injected
extern int max_step;           // length of a tap, frames
extern int isMovingEvent;      // class of the latest drag movement: 0 slow, 1 medium, 2 fast; -1 before the first

// Gesture and frame.
extern int state;       // 0 idle, 1 tap, 2 drag
extern int step;        // frames of the current tap
extern int drag_step;   // frames of the current drag
extern int count;       // ink frames since the last touch-down
extern int POSITION_X;  // latest touch
extern int POSITION_Y;
extern int PREV_POSITION_X;  // touch before that
extern int PREV_POSITION_Y;
extern int DX;  // from there to here, measured while tapping or dragging
extern int DY;
extern int DRAG_START_X;  // current drag segment
extern int DRAG_START_Y;
extern int DRAG_END_X;
extern int DRAG_END_Y;
extern int TOUCH_ACTION;  // action code of the latest touch

// Set-up.
extern bool bWithInk;     // fixed by onInitSetting; without ink only the water is simulated and drawn
extern int SCREEN_WIDTH;  // view size given to onInitSetting, the viewport of every frame
extern int SCREEN_HEIGHT;

// a - b as Java's int computes it: a host may report any coordinate, and an overflow of ours would be undefined.
inline int wrappingDifference(int a, int b) {
    return static_cast<int>(static_cast<unsigned>(a) - static_cast<unsigned>(b));
}

// Counts a frame of a gesture, which may be held for as long as a finger has patience.
inline void countFrame(int& frames) {
    if (frames < std::numeric_limits<int>::max()) ++frames;
}
