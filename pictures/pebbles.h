// Pebbles painted one over the other, as they lie on the bed of a river.
#pragma once

#include "pictures/canvas.h"
#include "pictures/noise.h"

namespace tidemark {

// Covers the canvas with pebbles; `unit` is the radius of a middling one in pixels.
void scatterPebbles(Canvas& canvas, float unit, Random& random, const CloudTile& clouds);

}  // namespace tidemark
