#include "water/ripples.h"

#include <gtest/gtest.h>

#include <limits>
#include <vector>

#include "reference/kernel_set.h"

namespace {

// Elements before and after the field, which must not change.
constexpr int kGuard = 40;

struct Field {
    int countA, countB;
    std::vector<float> values = std::vector<float>(static_cast<std::size_t>(countA * countB + 2 * kGuard), 0.5f);

    RippleField view(int extentA, int extentB) { return {values.data() + kGuard, extentA, extentB, countA, countB}; }
};

}  // namespace

TEST(Ripples, matchThePlainLoop) {
    for (const int countA : {3, 5, 7, 12, 17}) {
        for (const int countB : {1, 3, 6, 11}) {
            for (float a = -40.0f; a < 40.0f; a += 1.7f) {
                for (float b = -90.0f; b < 90.0f; b += 7.9f) {
                    Field field = {countA, countB};
                    Field expected = {countA, countB};
                    addRipple(field.view(64, 128), a, b, -1.5f);
                    kScalar.ripple(expected.view(64, 128), a, b, -1.5f);
                    ASSERT_EQ(field.values, expected.values) << a << ", " << b << " in " << countA << " x " << countB;
                }
            }
        }
    }
}

TEST(Ripples, anyCentreIsSafe) {
    const float inf = std::numeric_limits<float>::infinity();
    const float nan = std::numeric_limits<float>::quiet_NaN();
    Field field = {13, 11};
    const Field untouched = field;
    for (const float position : {inf, -inf, nan, 1e30f, -1e30f, 3e9f, -3e9f, 1e4f}) {
        addRipple(field.view(64, 64), position, 0.0f, 1.0f);
        addRipple(field.view(64, 64), 0.0f, position, 1.0f);
        addRipple(field.view(0, 0), position, position, 1.0f);
        EXPECT_EQ(field.values, untouched.values) << position;
    }
}
