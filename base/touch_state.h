// The latest touch, as the native methods store it and the engine reads it: screen pixels as the host reports them,
// origin at the top left, y downwards. At load all are 0, and they keep their values when no finger is down.
#pragma once

extern int POSITION_X;
extern int POSITION_Y;
extern int DX;  // from the touch before, measured while tapping or dragging
extern int DY;
