#include "pictures/procedural_pictures.h"

#include <gtest/gtest.h>

#include <utility>

using namespace tidemark;

TEST(ProceduralPictures, GroundsOfAnySizeAreWholeAndOpaque) {
    for (Picture (*const ground)(int, int) : {riverBed, tiledPool, sandyShore}) {
        for (const auto& [width, height] : {std::pair{216, 384}, {384, 216}, {1, 1}, {3, 200}, {200, 1}}) {
            const Picture picture = ground(width, height);
            ASSERT_EQ(picture.rgba.size(), static_cast<std::size_t>(width * height) * 4);
            for (std::size_t alpha = 3; alpha < picture.rgba.size(); alpha += 4) ASSERT_EQ(picture.rgba[alpha], 255);
        }
    }
}
