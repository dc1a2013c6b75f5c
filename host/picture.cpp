#include "host/picture.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

unsigned Pictures::newSince(const Pictures& before) const {
    return (portrait == before.portrait ? 0u : kPortrait) | (landscape == before.landscape ? 0u : kLandscape) |
           (light == before.light ? 0u : kLight);
}

Picture cropToAspect(const Picture& picture, double aspectWidth, double aspectHeight) {
    const double aspect = aspectWidth / aspectHeight;
    Picture crop;
    crop.width = std::clamp(static_cast<int>(std::lround(picture.height * aspect)), 1, picture.width);
    crop.height = std::clamp(static_cast<int>(std::lround(picture.width / aspect)), 1, picture.height);
    const int left = (picture.width - crop.width) / 2;
    const int top = (picture.height - crop.height) / 2;
    const auto rowBytes = static_cast<std::ptrdiff_t>(crop.width) * 4;
    crop.rgba.reserve(static_cast<std::size_t>(rowBytes * crop.height));
    for (int row = 0; row < crop.height; ++row) {
        const auto start = picture.rgba.begin() + (std::ptrdiff_t{top + row} * picture.width + left) * 4;
        crop.rgba.insert(crop.rgba.end(), start, start + rowBytes);
    }
    return crop;
}
