// Painted backgrounds and light, for water without a photo, in any size. The result depends only on the size.
#pragma once

#include "host/picture.h"

namespace tidemark {

Picture riverBed(int width, int height);    // pebbles
Picture tiledPool(int width, int height);   // glazed scales in blue and green
Picture sandyShore(int width, int height);  // ribbed sand with starfish
Picture waterLight(int side);

}  // namespace tidemark
