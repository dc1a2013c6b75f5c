// Sand as the waves leave it near a beach: ribs, grains, and starfish on it.
#pragma once

#include "pictures/canvas.h"
#include "pictures/noise.h"

namespace tidemark {

// Covers the canvas; `unit` is about half the distance from rib to rib in pixels.
void rakeSand(Canvas& canvas, float unit, Random& random, const CloudTile& clouds);

}  // namespace tidemark
