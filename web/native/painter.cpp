// The module of the playground's worker: paints the built-in pictures. web/src/painter.ts declares its functions.
#include <emscripten.h>

#include "pictures/procedural_pictures.h"

using namespace tidemark;

namespace {

Picture painted;

const std::uint8_t* keep(Picture picture) {
    painted = std::move(picture);
    return painted.rgba.data();
}

}  // namespace

extern "C" {

// Rows from the top, four bytes a pixel, until the next is painted.
EMSCRIPTEN_KEEPALIVE const std::uint8_t* paintRiverBed(int width, int height) {
    return keep(riverBed(width, height));
}
EMSCRIPTEN_KEEPALIVE const std::uint8_t* paintTiledPool(int width, int height) {
    return keep(tiledPool(width, height));
}
EMSCRIPTEN_KEEPALIVE const std::uint8_t* paintSandyShore(int width, int height) {
    return keep(sandyShore(width, height));
}
EMSCRIPTEN_KEEPALIVE const std::uint8_t* paintWaterLight(int side) {
    return keep(waterLight(side));
}

}  // extern "C"
