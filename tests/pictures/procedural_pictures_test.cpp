#include "pictures/procedural_pictures.h"

#include <gtest/gtest.h>

#include <algorithm>

// Of all whole squares of the picture the least difference between their brightest and darkest green.
static int leastContrast(const Picture& picture, int side) {
    int least = 255;
    for (int square = 0; square < picture.width / side * (picture.height / side); ++square) {
        const int left = square % (picture.width / side) * side, top = square / (picture.width / side) * side;
        int darkest = 255, brightest = 0;
        for (int i = 0; i < side * side; ++i) {
            const int pixel = (top + i / side) * picture.width + left + i % side;
            darkest = std::min<int>(darkest, picture.rgba[static_cast<std::size_t>(4 * pixel + 1)]);
            brightest = std::max<int>(brightest, picture.rgba[static_cast<std::size_t>(4 * pixel + 1)]);
        }
        least = std::min(least, brightest - darkest);
    }
    return least;
}

TEST(ProceduralPictures, GroundsOfAnySizeShowDetailEverywhere) {
    for (Picture (*const ground)(int, int) : {riverBed, tiledPool, sandyShore}) {
        for (const auto& [width, height] : {std::pair{216, 384}, {384, 216}, {1, 1}, {3, 200}, {200, 1}}) {
            const Picture picture = ground(width, height);
            ASSERT_EQ(picture.rgba.size(), static_cast<std::size_t>(width * height) * 4);
            for (std::size_t alpha = 3; alpha < picture.rgba.size(); alpha += 4) ASSERT_EQ(picture.rgba[alpha], 255);
            EXPECT_GT(leastContrast(picture, 54), 40) << width << "x" << height;
        }
    }
}

TEST(ProceduralPictures, WaterLightIsBluishAndNeverDark) {
    const Picture light = waterLight(128);
    EXPECT_GT(leastContrast(light, 64), 60);
    for (std::size_t pixel = 0; pixel < light.rgba.size(); pixel += 4) {
        ASSERT_GE(light.rgba[pixel + 2], std::max<int>(light.rgba[pixel], 121));
    }
}
