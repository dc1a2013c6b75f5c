#include "water/waves.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <vector>

#include "reference/kernel_set.h"

namespace {

const float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr int kStride = 20;
constexpr int kRows = 9;

struct Surface {
    std::vector<float> v = std::vector<float>(kStride * kRows);
    std::vector<float> h = v;

    bool step(const KernelSet& kernels, const WaveRegion& region, bool checkCalm, float damping, float speed) {
        return kernels.wave(v.data(), h.data(), region, checkCalm, damping, speed);
    }
};

bool same(const std::vector<float>& a, const std::vector<float>& b) {
    return std::ranges::equal(a, b, [](float x, float y) { return x == y || (std::isnan(x) && std::isnan(y)); });
}

}  // namespace

// Expects exact equality, because four lanes add in the same order as one; the arrays outside the region must not
// change. Rows of 20 or more fill the stride, so the end of one row is the neighbour of the next.
TEST(Waves, matchThePlainLoopAtEveryWidthAndOffset) {
    std::mt19937 random(1);
    std::uniform_real_distribution<float> height(-120.0f, 120.0f);
    const float wild[] = {kNan, kInfinity, -kInfinity};
    for (int first = 0; first <= 4; ++first) {
        for (const int width : {0, 1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, kStride - 1, kStride, kStride + 3}) {
            for (const bool isWild : {false, true}) {
                for (const float damping : {0.94f, 0.95f}) {
                    SCOPED_TRACE(testing::Message() << width << " from " << first << ", damping " << damping);
                    Surface actual;
                    for (float& h : actual.h) h = height(random);
                    for (float& v : actual.v) v = height(random) / 2.0f;
                    for (int i = 0; isWild && i < 9; ++i) {
                        (i < 4 ? actual.v : actual.h)[random() % actual.h.size()] = wild[i % 3];
                    }
                    Surface expected = actual;
                    const WaveRegion region = {first, 2, first + width, kRows - 3, kStride};
                    EXPECT_EQ(
                        actual.step(kLibrary, region, true, damping, 0.3f),
                        expected.step(kScalar, region, true, damping, 0.3f));
                    EXPECT_TRUE(same(actual.v, expected.v));
                    EXPECT_TRUE(same(actual.h, expected.h));
                }
            }
        }
    }
}

// Tests every vertex of a row, because the first four are computed as a group and the rest one by one.
TEST(Waves, calmIfEverySpeedIsWithinTheInclusiveBand) {
    for (int x = 1; x <= 7; ++x) {
        SCOPED_TRACE(x);
        const auto isCalm = [x](float speed, float other, bool check) {
            Surface s;
            s.v[static_cast<std::size_t>(kStride + x)] = speed;
            s.v[static_cast<std::size_t>(2 * kStride + 8 - x)] = other;
            return s.step(kLibrary, {1, 1, 8, 3, kStride}, check, 1.0f, 0.0f);
        };
        EXPECT_TRUE(isCalm(0.009f, -0.009f, true));
        EXPECT_FALSE(isCalm(std::nextafter(0.009f, 1.0f), 0.0f, true));
        EXPECT_FALSE(isCalm(0.0f, std::nextafter(-0.009f, -1.0f), true));
        EXPECT_TRUE(isCalm(kNan, 0.0f, true)) << "NaN counts as calm";
        EXPECT_FALSE(isCalm(kNan, 1.0f, true)) << "NaN does not hide a fast vertex";
        EXPECT_TRUE(isCalm(5.0f, 5.0f, false));
    }
    Surface moving;
    moving.v.assign(moving.v.size(), 5.0f);
    const Surface before = moving;
    EXPECT_TRUE(moving.step(kLibrary, {1, 3, 8, 3, kStride}, true, 0.5f, 0.5f));
    EXPECT_TRUE(moving.step(kLibrary, {5, 1, 5, 3, kStride}, true, 0.5f, 0.5f));
    EXPECT_EQ(moving.v, before.v) << "an empty region changes nothing";
}

// The lowest standing wave of a square with a fixed border has a known frequency.
TEST(Waves, standingWaveHasTheAnalyticFrequency) {
    constexpr int n = 33;
    constexpr std::size_t middle = 16 * n + 16;
    std::vector<float> v(n * n), h(n * n);
    const double k = std::acos(-1.0) / (n - 1);
    for (int i = 0; i < n * n; ++i) {
        h[static_cast<std::size_t>(i)] = static_cast<float>(std::sin(k * (i % n)) * std::sin(k * (i / n)));
    }
    // Semi-implicit steps give 2 - 2 cos(w) = waveSpeed * 8 sin^2(k / 2); smoothing changes w only slightly.
    const double w = std::acos(1.0 - 0.2 * 4.0 * std::pow(std::sin(k / 2), 2));
    int crossing = 0;
    while (h[middle] > 0.0f && ++crossing < 1000) {
        stepWaves(v.data(), h.data(), {1, 1, n - 1, n - 1, n}, false, 1.0f, 0.2f);
    }
    EXPECT_NEAR(crossing, std::acos(-1.0) / 2 / w, 3.0);
}
