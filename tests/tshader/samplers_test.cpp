#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "tshader/texture.h"

static const float kNan = std::numeric_limits<float>::quiet_NaN();

TEST(Vectors, roundAndCompareLikeTheShaders) {
    EXPECT_EQ(fract(-0.25f), 0.75f);
    EXPECT_EQ(fract(-1e-9f), 1.0f) << "rounded once, after the subtraction";
    EXPECT_EQ((Vec2(5.0f, 7.0f) / 49.0f).x, 5.0f / 49.0f) << "differs from 5 * (1 / 49)";
    EXPECT_FALSE(isLE(Vec2(1.0f, 2.0f), 1.5f) || isGT(Vec2(1.0f, 2.0f), 1.5f));
    EXPECT_FALSE(isLE(Vec4(0.0f, 0.0f, 0.0f, kNan), 1.0f) || isGT(Vec4(kNan, 2.0f, 2.0f, 2.0f), 1.0f));
}

TEST(Samplers, coverTheTextureAndNeverReadOutside) {
    std::vector<float> texels(13, 1.0f);
    texels.front() = 0.0f;
    texels[11] = 5.0f;
    texels.back() = kNan;  // Outside the texture; reading it gives NaN even with a weight of 0.
    const Texture<float> t = {texels.data(), 4, 3};
    for (const float x : {kNan, -1e30f, 0.0f, 0.4f, 1.0f, 3e38f}) {
        const bool first = !(x > 0.0f), last = x >= 1.0f;
        const float corner = first ? 0.0f : last ? 5.0f : 1.0f;
        EXPECT_EQ(texture2D(t, Vec2(x, x)), corner) << x;
        EXPECT_NEAR(texture2DLinear(t, Vec2(x, x)), corner, 1e-6f) << x;
    }
    // The second texel's centre is at 1/3.
    EXPECT_FLOAT_EQ(texture2DLinear(t, Vec2(0.5f / 3.0f, 0.0f)), 0.5f);
    EXPECT_EQ(texture2D(t, Vec2(0.49f / 3.0f, 0.0f)), 0.0f);
    for (const Texture<float>& empty : {Texture<float>{}, {texels.data(), 0, 3}, {texels.data(), 3, 0}}) {
        EXPECT_EQ(texture2DLinear(empty, Vec2(0.5f)) + texture2D(empty, Vec2(0.5f)), 0.0f);
    }
}
