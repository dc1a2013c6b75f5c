#pragma once

#include <cmath>

#include "host/picture.h"

// Returns a picture of gentle gradients, in which a small position error is a small colour error.
inline tidemark::Picture smoothPicture(int width, int height, int variant) {
    tidemark::Picture picture = {width, height, {}};
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const double u = (x + 0.5) / width;
            const double v = (y + 0.5) / height;
            for (const double value : {u, v, 0.5 + 0.5 * std::sin(3 * u + 2 * v + variant)}) {
                picture.rgba.push_back(static_cast<std::uint8_t>(std::lround(40 + 140 * value)));
            }
            picture.rgba.push_back(255);
        }
    }
    return picture;
}
