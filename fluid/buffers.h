// The engine's CPU buffers: all five of them, or none.
#pragma once

class Fluid;

// Replaces the buffers by new ones of GridWidth x GridHeight texels, the velocity zero. Without memory for all of them
// there are none afterwards, which is logged, and the ink stands still while the water goes on.
void allocateBuffers(Fluid& engine);

void freeBuffers(Fluid& engine);
