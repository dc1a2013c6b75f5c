#pragma once

// Updates the gesture state machine with a touch event: classifies it as a tap or a drag, and a drag by its speed.
// Screen pixels, y down; `action` is a MotionAction; any other value only changes the position.
void touch(int x, int y, int action, float pressure);
