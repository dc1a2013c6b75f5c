// Factors for the colours of a picture, which apply when it is handed over.
#pragma once

#include "host/look.h"
#include "host/picture_source.h"

namespace tidemark {

struct Shade {
    float red, green, blue;  // 0 to 1

    bool operator==(const Shade&) const = default;
};

// `brightness`: the mean of all channels of the picture, 0 to 1.
Shade shadeOf(const Look& look, PictureSlot slot, float brightness);

}  // namespace tidemark
