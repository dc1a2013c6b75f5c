// A picture in memory: rows from the top, four bytes a pixel in R, G, B, A order, no padding.
#pragma once

#include <cstdint>
#include <vector>

struct Picture {
    int width = 0;
    int height = 0;
    std::vector<std::uint8_t> rgba;  // 4 * width * height bytes

    bool operator==(const Picture&) const = default;
};

// What the water lies over in portrait and in landscape, and the light that its waves throw back.
struct Pictures {
    Picture portrait, landscape, light;

    // Some of the three, as a sum.
    enum : unsigned { kPortrait = 1, kLandscape = 2, kBackgrounds = 3, kLight = 4, kAll = 7 };

    // Those that are others than in `before`.
    unsigned newSince(const Pictures& before) const;
};

// The largest middle part of `picture` that has the proportions aspectWidth : aspectHeight.
Picture cropToAspect(const Picture& picture, double aspectWidth, double aspectHeight);
