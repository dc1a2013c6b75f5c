#include <gtest/gtest.h>

#include <limits>
#include <numeric>
#include <utility>
#include <vector>

#include "tshader/texture.h"

namespace {

const float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

}  // namespace

TEST(Vectors, roundAndCompareLikeTheShaders) {
    EXPECT_EQ(fract(-0.25f), 0.75f);
    EXPECT_EQ(fract(-1e-9f), 1.0f) << "rounded once, after the subtraction";
    EXPECT_EQ((Vec2(5.0f, 7.0f) / 49.0f).x, 5.0f / 49.0f) << "differs from 5 * (1 / 49)";
    EXPECT_FALSE(isLE(Vec2(1.0f, 2.0f), 1.5f) || isGT(Vec2(1.0f, 2.0f), 1.5f));
    EXPECT_FALSE(isLE(Vec4(0.0f, 0.0f, 0.0f, kNan), 1.0f) || isGT(Vec4(kNan, 2.0f, 2.0f, 2.0f), 1.0f));
}

TEST(Samplers, spanTheTextureFromFirstToLastTexelCentre) {
    for (const auto& [width, height] : {std::pair{1, 1}, {3, 2}, {7, 9}, {91, 161}}) {
        std::vector<float> texels(static_cast<std::size_t>(width * height));
        std::iota(texels.begin(), texels.end(), 0.0f);
        const Texture<float> t = {texels.data(), width, height};
        EXPECT_EQ(texture2DLinear(t, Vec2(0.0f)), 0.0f);
        EXPECT_EQ(texture2DLinear(t, Vec2(1.0f)), texels.back());
        EXPECT_FLOAT_EQ(texture2DLinear(t, Vec2(0.5f)), 0.5f * texels.back());
        // The centre of the first texel in pixels is between two texels for one sampler and the texel for the other.
        const vec2 inverseSize = 1.0f / Vec2(static_cast<float>(width), static_cast<float>(height));
        EXPECT_NEAR(texture2DLinear(t, Vec2(0.5f, 0.0f) * inverseSize), 0.5f - 0.5f * inverseSize.x, 1e-6f);
        for (int i = 0; i < width * height; ++i) {
            const vec2 centre = {static_cast<float>(i % width) + 0.5f, static_cast<float>(i / width) + 0.5f};
            ASSERT_EQ(texture2D(t, centre * inverseSize), static_cast<float>(i)) << width;
        }
    }
}

TEST(Samplers, neverLeaveTheTexture) {
    std::vector<float> ones(12, 1.0f);
    const float coordinates[] = {kNan, -kInfinity, -1e30f, -0.0f, 0.4f, 1.0000001f, 3e38f, kInfinity};
    for (const float x : coordinates) {
        for (const float y : coordinates) {
            for (const int width : {0, 1, 4}) {
                const Texture<float> t = {ones.data(), width, 3};
                EXPECT_NEAR(texture2DLinear(t, Vec2(x, y)), width ? 1.0f : 0.0f, 1e-6f) << x << ", " << y;
                EXPECT_EQ(texture2D(t, Vec2(x, y)), width ? 1.0f : 0.0f) << x << ", " << y;
            }
        }
    }
}
