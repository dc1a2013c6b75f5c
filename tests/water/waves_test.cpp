#include "water/waves.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <vector>

namespace {

const float kNan = std::numeric_limits<float>::quiet_NaN();

struct Surface {
    int width;
    int height;
    std::vector<float> h;
    std::vector<float> v;

    Surface(int w, int rows) : width(w), height(rows), h(size()), v(size()) {}
    std::size_t size() const { return static_cast<std::size_t>(width * height); }
    std::size_t at(int x, int y) const { return static_cast<std::size_t>(y * width + x); }
    WaveRegion interior() const { return {1, 1, width - 1, height - 1, width}; }
    bool step(bool checkCalm = true, float damping = 1.0f, float speed = 0.0f) {
        return stepWaves(v.data(), h.data(), interior(), checkCalm, damping, speed);
    }
};

// The three passes, one vertex at a time.
bool plainStep(std::vector<float>& v, std::vector<float>& h, const WaveRegion& r, float damping, float speed) {
    bool calm = true;
    const auto laplacian = [&r](const std::vector<float>& f, int i) {
        const auto at = [&f](int k) { return f[static_cast<std::size_t>(k)]; };
        float sum = -at(i) * 4.0f;
        sum += at(i - r.stride);
        sum += at(i - 1);
        sum += at(i + 1);
        return sum + at(i + r.stride);
    };
    const auto sweep = [&r](auto visit) {
        for (int y = r.yStart; y < r.yEnd; ++y) {
            for (int x = r.xStart; x < r.xEnd; ++x) visit(y * r.stride + x, static_cast<std::size_t>(y * r.stride + x));
        }
    };
    sweep([&](int i, std::size_t k) {
        v[k] = (laplacian(h, i) * speed + v[k]) * damping;
        if (v[k] > 0.009f || v[k] < -0.009f) calm = false;
    });
    sweep([&](int, std::size_t k) { h[k] = std::fmin(100.0f, std::fmax(-100.0f, h[k] + v[k])); });
    const std::vector<float> s = h;
    sweep([&](int i, std::size_t k) { h[k] = laplacian(s, i) * (damping == 0.94f ? 0.068f : 0.018f) + h[k]; });
    return calm;
}

}  // namespace

TEST(Waves, everyWidthAndOffsetEqualsTheStepTakenOneByOneAndTouchesNothingElse) {
    std::mt19937 random(1);
    std::uniform_real_distribution<float> height(-120.0f, 120.0f);
    constexpr int stride = 20;
    constexpr int rows = 9;
    for (int first = 1; first <= 4; ++first) {
        for (int width = 0; width <= 14; ++width) {
            for (const float damping : {0.94f, 0.95f}) {
                std::vector<float> h(stride * rows);
                std::vector<float> v(stride * rows);
                for (float& value : h) value = height(random);
                for (float& value : v) value = height(random) / 100.0f;
                auto expectedH = h;
                auto expectedV = v;
                const WaveRegion region = {first, 2, first + width, rows - 3, stride};
                const bool calm = stepWaves(v.data(), h.data(), region, true, damping, 0.3f);
                EXPECT_EQ(calm, plainStep(expectedV, expectedH, region, damping, 0.3f));
                // Exact: grouped and single vertices add in the same order; the untouched rest is the guard.
                EXPECT_EQ(v, expectedV) << "first " << first << " width " << width;
                EXPECT_EQ(h, expectedH) << "first " << first << " width " << width;
            }
        }
    }
}

TEST(Waves, oneRaisedVertexSpreadsToItsFourNeighbours) {
    Surface s(16, 16);
    s.h[s.at(7, 8)] = 1.0f;
    EXPECT_TRUE(s.step());
    EXPECT_FLOAT_EQ(s.h[s.at(7, 8)], 0.928f);
    for (const auto k : {s.at(6, 8), s.at(8, 8), s.at(7, 7), s.at(7, 9)}) EXPECT_FLOAT_EQ(s.h[k], 0.018f);
    EXPECT_EQ(s.h[s.at(6, 7)], 0.0f);
    EXPECT_EQ(s.v, std::vector<float>(s.size(), 0.0f));

    Surface smoother(16, 16);
    smoother.h[smoother.at(7, 8)] = 1.0f;
    smoother.step(true, 0.94f);
    EXPECT_FLOAT_EQ(smoother.h[smoother.at(6, 8)], 0.068f);
}

TEST(Waves, heightsAreLimitedBeforeTheyAreSmoothed) {
    Surface s(5, 5);
    s.h[s.at(2, 2)] = 90.0f;
    s.v[s.at(2, 2)] = 60.0f;
    s.step();
    EXPECT_FLOAT_EQ(s.h[s.at(2, 2)], 100.0f * 0.928f);
    s.h[s.at(2, 2)] = -90.0f;
    s.v[s.at(2, 2)] = -60.0f;
    s.step();
    EXPECT_NEAR(s.h[s.at(2, 2)], -100.0f * 0.928f, 0.5f);
}

// Every vertex of a row in turn, so that grouped and single ones are both asked.
TEST(Waves, onlyHeightsThatAreNumbersAreLimited) {
    for (int x = 1; x <= 7; ++x) {
        SCOPED_TRACE(x);
        Surface s(9, 4);
        s.h[s.at(x, 1)] = kNan;
        stepWaves(s.v.data(), s.h.data(), {x, 1, x + 1, 2, 9}, false, 1.0f, 0.0f);
        EXPECT_TRUE(std::isnan(s.h[s.at(x, 1)]));
        Surface row(9, 4);
        row.h[row.at(x, 1)] = kNan;
        row.step();
        EXPECT_TRUE(std::isnan(row.h[row.at(x, 1)]));
        Surface high(9, 4);
        high.v[high.at(x, 1)] = std::numeric_limits<float>::infinity();
        stepWaves(high.v.data(), high.h.data(), {1, 1, 8, 2, 9}, false, 1.0f, 0.0f);
        EXPECT_FLOAT_EQ(high.h[high.at(x, 1)], 100.0f * (1.0f - 4.0f * 0.018f));
    }
}

TEST(Waves, calmMeansEverySpeedWithinTheBandBothEndsIncluded) {
    for (int x = 1; x <= 7; ++x) {
        const auto calmWith = [x](float speed, bool check) {
            Surface s(9, 4);
            s.v[s.at(x, 2)] = speed;
            return s.step(check);
        };
        EXPECT_TRUE(calmWith(0.009f, true));
        EXPECT_TRUE(calmWith(-0.009f, true));
        EXPECT_FALSE(calmWith(std::nextafter(0.009f, 1.0f), true)) << x;
        EXPECT_FALSE(calmWith(std::nextafter(-0.009f, -1.0f), true)) << x;
        EXPECT_TRUE(calmWith(5.0f, false));
        EXPECT_TRUE(calmWith(kNan, true)) << "a speed that is not a number counts as calm";

        Surface mixed(9, 4);
        mixed.v[mixed.at(x, 1)] = kNan;
        mixed.v[mixed.at(8 - x, 2)] = 1.0f;
        EXPECT_FALSE(mixed.step()) << "and hides no moving one";
    }
    Surface nothing(9, 4);
    nothing.v.assign(nothing.size(), 5.0f);
    const auto before = nothing.v;
    EXPECT_TRUE(stepWaves(nothing.v.data(), nothing.h.data(), {1, 3, 8, 3, 9}, true, 0.5f, 0.5f));
    EXPECT_TRUE(stepWaves(nothing.v.data(), nothing.h.data(), {5, 1, 5, 3, 9}, true, 0.5f, 0.5f));
    EXPECT_EQ(nothing.v, before) << "an empty region changes nothing";
}

// The lowest standing wave of a fixed square turns at the speed that the wave equation gives it.
TEST(Waves, aStandingWaveSwingsAtItsOwnFrequency) {
    constexpr int n = 33;
    constexpr float speed = 0.2f;
    Surface s(n, n);
    const double k = std::acos(-1.0) / (n - 1);
    for (int y = 0; y < n; ++y) {
        for (int x = 0; x < n; ++x) {
            s.h[s.at(x, y)] = static_cast<float>(std::sin(k * x) * std::sin(k * y));
        }
    }
    // Semi-implicit steps: 2 - 2 cos(w) = speed * 8 sin^2(k / 2), lightly smoothed away in passing.
    const double w = std::acos(1.0 - speed * 4.0 * std::pow(std::sin(k / 2), 2));
    int crossing = 0;
    while (s.h[s.at(16, 16)] > 0.0f && crossing < 1000) {
        s.step(false, 1.0f, speed);
        ++crossing;
    }
    EXPECT_NEAR(crossing, std::acos(-1.0) / 2 / w, 3.0);
    EXPECT_EQ(s.h[s.at(0, 16)], 0.0f) << "the edge stays where the host put it";
}

TEST(Waves, aRestingSurfaceStaysAtRestAndNeverLeavesTheLimits) {
    Surface s(12, 12);
    for (int i = 0; i < 50; ++i) EXPECT_TRUE(s.step(true, 0.98f, 0.3f));
    EXPECT_EQ(s.h, std::vector<float>(s.size(), 0.0f));

    std::mt19937 random(2);
    std::uniform_real_distribution<float> speed(-80.0f, 80.0f);
    for (float& value : s.v) value = speed(random);
    for (int i = 0; i < 200; ++i) {
        s.step(true, 0.999f, 0.45f);
        for (const float h : s.h) ASSERT_LE(std::fabs(h), 100.0f);
    }
}
