#pragma once

class Fluid;

// Replaces the engine's five CPU buffers by new ones of GridWidth x GridHeight texels; the velocity is zero. If one
// allocation fails, frees all of them and logs the failure. Frames then draw the water without moving or adding ink.
void allocateBuffers(Fluid& engine);

void freeBuffers(Fluid& engine);
