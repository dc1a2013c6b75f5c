#include "pictures/procedural_pictures.h"

#include <gtest/gtest.h>

#include <algorithm>

// The difference between the brightest and the darkest green value in a part of the picture.
static int contrast(const Picture& picture, int left, int top, int width, int height) {
    int darkest = 255, brightest = 0;
    for (int row = top; row < top + height; ++row) {
        for (int column = left; column < left + width; ++column) {
            const int green = picture.rgba[static_cast<std::size_t>(row * picture.width + column) * 4 + 1];
            darkest = std::min(darkest, green);
            brightest = std::max(brightest, green);
        }
    }
    return brightest - darkest;
}

TEST(ProceduralPictures, GroundsAreRepeatableAndShowDetailEverywhere) {
    for (Picture (*const ground)(int, int) : {riverBed, tiledPool, sandyShore}) {
        for (const auto& [width, height] : {std::pair{216, 384}, std::pair{384, 216}}) {
            const Picture picture = ground(width, height);
            ASSERT_EQ(picture.rgba.size(), static_cast<std::size_t>(width * height) * 4);
            EXPECT_EQ(picture.rgba, ground(width, height).rgba);
            const int side = 54;
            for (int top = 0; top + side <= height; top += side) {
                for (int left = 0; left + side <= width; left += side) {
                    EXPECT_GT(contrast(picture, left, top, side, side), 40) << left << ", " << top;
                }
            }
            for (std::size_t alpha = 3; alpha < picture.rgba.size(); alpha += 4) ASSERT_EQ(picture.rgba[alpha], 255);
        }
        for (const auto& [width, height] : {std::pair{1, 1}, std::pair{3, 200}, std::pair{200, 1}}) {
            EXPECT_EQ(ground(width, height).rgba.size(), static_cast<std::size_t>(width * height) * 4);
        }
    }
}

TEST(ProceduralPictures, WaterLightIsBluishAndNeverDark) {
    const Picture light = waterLight(128);
    EXPECT_EQ(light.rgba, waterLight(128).rgba);
    EXPECT_GT(contrast(light, 32, 32, 64, 64), 60);
    for (std::size_t pixel = 0; pixel < light.rgba.size(); pixel += 4) {
        ASSERT_GE(light.rgba[pixel + 2], light.rgba[pixel]);
        ASSERT_GT(light.rgba[pixel + 2], 120);
    }
}
