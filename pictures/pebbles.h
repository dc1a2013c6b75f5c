// A river bed: pebbles that overlap each other.
#pragma once

#include "pictures/canvas.h"
#include "pictures/noise.h"

namespace tidemark {

// Covers the canvas with pebbles; `unit` is the median radius of a pebble in pixels.
void scatterPebbles(Canvas& canvas, float unit, Random& random, const CloudTile& clouds);

}  // namespace tidemark
