#include "tshader/velocity_packing.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "reference/kernel_set.h"

TEST(VelocityPacking, matchesDoublePrecision) {
    const float infinity = std::numeric_limits<float>::infinity();
    std::vector<vec2> velocity = {
        {std::nanf(""), 1e-40f}, {infinity, -infinity}, {300.0f, -300.0f}, {0.0f, -0.0f}, {std::nanf(""), -1.5f}};
    // Values next to every step of the fraction byte, where rounding could change a byte.
    for (int n = -300; n < 255 * 255; ++n) {
        float below = static_cast<float>(n) / 255.0f - 127.0f, above = below;
        for (int k = 0; k < 3; ++k) {
            velocity.push_back({below, above});
            below = std::nextafter(below, -1e9f);
            above = std::nextafter(above, 1e9f);
        }
    }
    for (float c = -127.2f; c < 127.2f; c += 0.00037f) velocity.push_back({c, -c});
    std::vector<unsigned char> bytes(4 * velocity.size()), expected(bytes);
    packVelocity(velocity.data(), velocity.size(), bytes.data());
    kScalar.packing(velocity.data(), velocity.size(), expected.data());
    EXPECT_EQ(bytes, expected);
}
