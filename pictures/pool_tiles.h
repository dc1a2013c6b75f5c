// Glazed pool tiles in the shape of fish scales.
#pragma once

#include "pictures/canvas.h"
#include "pictures/noise.h"

namespace tidemark {

// Covers the canvas; `unit` is the radius of a tile in pixels.
void layTiles(Canvas& canvas, float unit, const CloudTile& clouds);

}  // namespace tidemark
