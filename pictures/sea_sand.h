// A beach below the water: rippled sand with starfish.
#pragma once

#include "pictures/canvas.h"
#include "pictures/noise.h"

namespace tidemark {

// Covers the canvas; `unit` is about half the distance between two sand ripples in pixels.
void rakeSand(Canvas& canvas, float unit, Random& random, const CloudTile& clouds);

}  // namespace tidemark
