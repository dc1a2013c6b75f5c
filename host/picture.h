// Pictures in memory, for front ends that decode their pictures there.
#pragma once

#include <cstdint>
#include <vector>

#include "host/picture_source.h"

namespace tidemark {

struct Look;

// Rows from the top, RGBA with 8 bits per channel, no padding.
struct Picture {
    int width = 0;
    int height = 0;
    std::vector<std::uint8_t> rgba;  // 4 * width * height bytes

    bool operator==(const Picture&) const = default;
};

// The backgrounds for portrait and landscape, and the light that the waves reflect.
struct Pictures {
    Picture portrait, landscape, light;
};

// Returns the largest centred part of `picture` with the proportions width : height. A part with more than width x
// height pixels is scaled down to that size; each new pixel is the mean of the area that it covers.
Picture fitted(const Picture& picture, int width, int height);

// Transfers a picture to the library without changes.
void handOver(PictureSlot slot, const Picture& picture);

// Return a source of `pictures`, which must outlive it: with the colours adjusted as the look requires (see shade.h),
// or unchanged.
PictureSource sourceOf(const Pictures& pictures, const Look& look);
PictureSource sourceOf(const Pictures& pictures);

}  // namespace tidemark
