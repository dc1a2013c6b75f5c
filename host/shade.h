// Factors for the colours of a picture, applied when it is transferred.
#pragma once

#include "host/look.h"
#include "host/picture_source.h"

namespace tidemark {

struct Shade {
    float red, green, blue;  // 0 to 1

    bool operator==(const Shade&) const = default;
};

// Returns the factors for a picture. `brightness` is the mean of all its channels, 0 to 1.
Shade shadeOf(const Look& look, PictureSlot slot, float brightness);

}  // namespace tidemark
