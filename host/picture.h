// Pictures in the host's own memory, for faces whose pictures are there.
#pragma once

#include <cstdint>
#include <vector>

#include "host/picture_source.h"

namespace tidemark {

struct Look;

// Rows from the top, four bytes a pixel in R, G, B, A order, no padding.
struct Picture {
    int width = 0;
    int height = 0;
    std::vector<std::uint8_t> rgba;  // 4 * width * height bytes

    bool operator==(const Picture&) const = default;
};

// The pictures under the water in portrait and in landscape, and the light that its waves reflect.
struct Pictures {
    Picture portrait, landscape, light;
};

// The largest middle part of `picture` that has the proportions width : height, scaled down to width x height pixels
// where it has more. Each pixel of the result is the mean of the area that it covers.
Picture fitted(const Picture& picture, int width, int height);

// Hands a picture over as it is.
void handOver(PictureSlot slot, const Picture& picture);

// Hands over pictures that stay where they are, in the colours that the look gives them, or in their own.
PictureSource sourceOf(const Pictures& pictures, const Look& look);
PictureSource sourceOf(const Pictures& pictures);

}  // namespace tidemark
