// Pictures for water without a photo: what lies below it, sunlit, in any size and proportions, and the light that the
// water throws back. Always the same pixels.
#pragma once

#include "host/picture.h"

namespace tidemark {

Picture riverBed(int width, int height);    // pebbles
Picture tiledPool(int width, int height);   // glazed scales in blue and green
Picture sandyShore(int width, int height);  // ribbed sand with starfish
Picture waterLight(int side);

}  // namespace tidemark
