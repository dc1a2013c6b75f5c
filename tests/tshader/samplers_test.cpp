#include <gtest/gtest.h>

#include <limits>
#include <numeric>

#include "plain.h"

namespace {

const float kNan = std::nanf("");
constexpr float kInfinity = std::numeric_limits<float>::infinity();

TEST(Vectors, RoundAndCompareLikeTheShaders) {
    EXPECT_EQ(fract(-0.25f), 0.75f);
    EXPECT_EQ(fract(-1e-9f), 1.0f) << "rounded once, after the subtraction";
    EXPECT_EQ((Vec2(5.0f, 7.0f) / 49.0f).x, 5.0f / 49.0f) << "differs from 5 * (1 / 49)";
    EXPECT_FALSE(isLE(Vec2(1.0f, 2.0f), 1.5f) || isGT(Vec2(1.0f, 2.0f), 1.5f));
    EXPECT_FALSE(isLE(Vec4(0.0f, 0.0f, 0.0f, kNan), 1.0f) || isGT(Vec4(kNan, 2.0f, 2.0f, 2.0f), 1.0f));
}

TEST(Samplers, SpanTheTextureFromFirstToLastTexelCentre) {
    for (const auto& [width, height] : {std::pair{1, 1}, {3, 2}, {7, 9}, {91, 161}}) {
        Image<float> t(width, height);
        std::iota(t.floats().begin(), t.floats().end(), 0.0f);
        EXPECT_EQ(texture2DLinear<float>(t, Vec2(0.0f)), 0.0f);
        EXPECT_EQ(texture2DLinear<float>(t, Vec2(1.0f)), t.at(width - 1, height - 1));
        EXPECT_FLOAT_EQ(texture2DLinear<float>(t, Vec2(0.5f)), 0.5f * t.at(width - 1, height - 1));
        // The centre of the first texel in pixels is between two texels for one sampler and the texel for the other.
        const vec2 inverseSize = 1.0f / Vec2(static_cast<float>(width), static_cast<float>(height));
        EXPECT_NEAR(texture2DLinear<float>(t, Vec2(0.5f, 0.0f) * inverseSize), 0.5f - 0.5f * inverseSize.x, 1e-6f);
        for (int j = 0; j < height; ++j)
            for (int i = 0; i < width; ++i) {
                const vec2 centre = Vec2(static_cast<float>(i) + 0.5f, static_cast<float>(j) + 0.5f);
                ASSERT_EQ(texture2D<float>(t, centre * inverseSize), t.at(i, j)) << i << ", " << j;
            }
    }
}

TEST(Samplers, NeverLeaveTheTexture) {
    Image<vec2> image(4, 3), column(1, 3);
    image.fill(1.0f);
    column.fill(1.0f);
    const float coordinates[] = {kNan, -kInfinity, -1e30f, -0.0f, 0.4f, 1.0000001f, 3e38f, kInfinity};
    for (float x : coordinates)
        for (float y : coordinates) {
            for (const Texture<vec2>& t : {Texture<vec2>(image), Texture<vec2>(column)}) {
                EXPECT_NEAR(texture2DLinear<vec2>(t, Vec2(x, y)).x, 1.0f, 1e-6f) << x << ", " << y;
                EXPECT_EQ(texture2D(t, Vec2(x, y)).y, 1.0f) << x << ", " << y;
            }
            for (const Texture<vec2>& empty : {Texture<vec2>{}, {image.data, 0, 3}, {image.data, 3, 0}}) {
                EXPECT_EQ(texture2DLinear<vec2>(empty, Vec2(x, y)).x + texture2D(empty, Vec2(x, y)).x, 0.0f);
            }
        }
}

}  // namespace
