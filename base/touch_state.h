// The latest touch: written by the native methods, read by the engine. Screen pixels, origin at the top left, y down.
// The values are 0 at load and are kept after the finger is lifted.
#pragma once

extern int POSITION_X;
extern int POSITION_Y;
extern int DX;  // movement since the previous touch event; updated only during a tap or drag
extern int DY;
