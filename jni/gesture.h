// Sorts touches into taps and drags, and drags by their speed.
#pragma once

// One touch event: screen pixels with y downwards, the action code of android.view.MotionEvent (0 down, 1 up, 2 move,
// 3 cancel; any other only moves the position), and the pressure as the platform reports it.
void touch(int x, int y, int action, float pressure);
