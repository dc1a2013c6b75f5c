#pragma once

#include "fluid/fluid.h"

// The ink's part of a frame: steps the simulation, then applies the preset of the current gesture and injects at the
// touch. `hostColor` is the ink colour, 0 to 1 per channel.
void stepInk(Color_ hostColor);
