// The part of a frame that runs only with ink.
#pragma once

#include "fluid/fluid.h"

// Advances the ink, then lets the gesture write its preset of parameters and inject at the touch. `hostColor` is the
// ink colour as the host gives it, 0 to 1 a channel.
void stepInk(Color_ hostColor);
