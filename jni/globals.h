// State that the native methods share between calls. Positions are screen pixels as the host reports them, origin at
// the top left, y downwards. There is one thread of control, so nothing is locked.
#pragma once

extern bool bWithInk;     // fixed by onInitSetting; without ink only the water is simulated and drawn
extern int SCREEN_WIDTH;  // view size given to onInitSetting, the viewport of every frame
extern int SCREEN_HEIGHT;
extern int state;  // gesture: 0 idle, 1 tap, 2 drag
extern int step;   // frames elapsed in the current tap
