#include "water/ripples.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

namespace {

constexpr int kGuard = 8;

// A field between guard zones.
struct Field {
    int countA;
    int countB;
    std::vector<float> values;

    Field(int a, int b) : countA(a), countB(b), values(static_cast<std::size_t>(a * b + 2 * kGuard)) {}
    float& at(int a, int b) { return values[static_cast<std::size_t>(kGuard + b * countA + a)]; }
    // Centre in cells.
    void ripple(float ca, float cb, float amplitude) {
        const auto a = static_cast<float>(countA);
        const auto b = static_cast<float>(countB);
        addRipple(
            {values.data() + kGuard, 64, 128, countA, countB}, (ca / a - 0.5f) * 64, (cb / b - 0.5f) * 128, amplitude);
    }
    bool untouched() const { return values == std::vector<float>(values.size(), 0.0f); }
};

}  // namespace

TEST(Ripples, aConeOfThreeCellsRisesAroundTheCentre) {
    std::vector<float> field(64 * 64);
    addRipple({field.data(), 100, 100, 64, 64}, 0.0f, 0.0f, 2.0f);
    const auto at = [&field](int a, int b) { return field[static_cast<std::size_t>(b * 64 + a)]; };
    EXPECT_FLOAT_EQ(at(32, 32), 6.0f);
    for (const int side : {-1, 1}) {
        EXPECT_FLOAT_EQ(at(32 + side, 32), 4.0f);
        EXPECT_FLOAT_EQ(at(32, 32 + side), 4.0f);
        EXPECT_FLOAT_EQ(at(32 + side, 32 - side), (3.0f - std::sqrt(2.0f)) * 2.0f);
        EXPECT_FLOAT_EQ(at(32 + 2 * side, 32), 2.0f);
        EXPECT_EQ(at(32 + 3 * side, 32), 0.0f);
    }
    addRipple({field.data(), 100, 100, 64, 64}, 0.0f, 0.0f, 2.0f);
    EXPECT_FLOAT_EQ(at(32, 32), 12.0f) << "impulses add up";
}

// Against the cone itself, for centres everywhere on fields of odd sizes: the cells 0, 1 and count - 1 of either axis
// and all that lies outside stay as they are.
TEST(Ripples, everyCentreAddsTheConeWhereItMay) {
    for (const int countA : {5, 7, 12, 17}) {
        for (const int countB : {3, 6, 11}) {
            for (float ca = -4.0f; ca < static_cast<float>(countA) + 4.0f; ca += 0.75f) {
                for (const float cb : {-2.0f, 2.5f, 5.0f, 9.25f, 14.0f}) {
                    Field field(countA, countB);
                    field.ripple(ca, cb, -1.5f);
                    Field expected(countA, countB);
                    for (int b = 2; b < countB - 1; ++b) {
                        for (int a = 2; a < countA - 1; ++a) {
                            const float d = 3.0f - std::hypot(ca - static_cast<float>(a), cb - static_cast<float>(b));
                            if (d > 0.0f) expected.at(a, b) = d * -1.5f;
                        }
                    }
                    for (std::size_t i = 0; i < field.values.size(); ++i) {
                        ASSERT_NEAR(field.values[i], expected.values[i], 2e-5f) << ca << ", " << cb << " in " << countA;
                    }
                }
            }
        }
    }
}

TEST(Ripples, anyCentreIsSafe) {
    const float inf = std::numeric_limits<float>::infinity();
    const float nan = std::numeric_limits<float>::quiet_NaN();
    for (const float position : {inf, -inf, nan, 1e30f, -1e30f, 3e9f, -3e9f, 1e4f}) {
        Field field(13, 11);
        addRipple({field.values.data() + kGuard, 64, 64, 13, 11}, position, 0.0f, 1.0f);
        addRipple({field.values.data() + kGuard, 64, 64, 13, 11}, 0.0f, position, 1.0f);
        addRipple({field.values.data() + kGuard, 0, 0, 13, 11}, position, position, 1.0f);
        EXPECT_TRUE(field.untouched()) << position;
    }
    Field flat(13, 11);
    flat.ripple(6.0f, 6.0f, 0.0f);
    EXPECT_TRUE(flat.untouched());
}
