#include "jni/ink_frame.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "jni/gesture.h"
#include "probes/gesture_state.h"
#include "tests/support/frame.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

constexpr int kLast = std::numeric_limits<int>::max();

using Preset = std::array<float, 7>;

Preset currentPreset() {
    return {
        static_cast<float>(fluid.DragMode),
        fluid.Radius,
        fluid.ImpulseDensity,
        fluid.SourceStrength,
        fluid.SourceRadius,
        fluid.VelocityDissipation,
        fluid.DensityDissipation};
}

void frames(int n) {
    for (int i = 0; i < n; ++i) stepInk({0.0f, 0.1f, 0.2f});
}

class InkFrame : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        resetGestures();
        Frame::setUp(480, 800, true);
        srand48(3);
    }

    // Returns the maximum density in units of 1 / 255.
    static int maxDensity() {
        glBindFramebuffer(GL_FRAMEBUFFER, fluid.Density.Ping.FboHandle);
        int most = 0;
        for (const Rgba& texel : readPixels(fluid.InkWidth, fluid.InkHeight)) {
            most = std::max(most, texel[0] * 255 + texel[1]);
        }
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return most;
    }
};

}  // namespace

TEST_F(InkFrame, tapGrowsForTenFramesAndEndsAfterThirteen) {
    touch(240, 400, kActionDown, 1.0f);
    for (int i = 0; i <= 12; ++i) {
        SCOPED_TRACE(i);
        ASSERT_EQ(state, kTapping);
        ASSERT_EQ(step, i);
        const GLuint ping = fluid.Density.Ping.TextureHandle;
        const float backward = fluid.BackwardStepSize;
        fluid.TimeStep = 0.5f;
        frames(1);
        float uploaded = -1.0f;
        glGetUniformfv(
            fluid.advect_density_program, glGetUniformLocation(fluid.advect_density_program, "BackwardStepSize"),
            &uploaded);
        EXPECT_EQ(uploaded, backward) << "the update uses the parameters of the previous frame";
        EXPECT_EQ(fluid.TimeStep, 0.25f);
        const auto frame = static_cast<float>(i);
        EXPECT_EQ(currentPreset(), (Preset{-1, 8 * frame, 200, i < 5 ? 12 * frame : 0, 40, 0.94f, 0.92f}));
        EXPECT_EQ(fluid.BackwardStepSize, i < 10 ? 0.1f * frame : 1.0f);
        EXPECT_EQ(fluid.Density.Ping.TextureHandle == ping, i < 10) << "an injection swaps once more";
        EXPECT_EQ(maxDensity() > 0, i > 0) << "a radius of 0 adds nothing";
    }
    EXPECT_EQ((std::array{state, step, count}), (std::array{0, 0, 13}));
    EXPECT_EQ(fluid.InkColor.r, static_cast<float>(0.05));
    EXPECT_EQ(fluid.InkColor.b, static_cast<float>(double{0.2f} + 0.05));
    EXPECT_EQ(std::pair(fluid.InkIntensity, fluid.InkColorOffset), std::pair(0.02f, 0.7f));
    frames(200);
    // 0.92 * 6 / 255 rounds to 6 / 255, so the decay stops there, where the ink is invisible in 8 bits.
    EXPECT_LE(maxDensity(), 6) << "the ink fades";
    EXPECT_EQ(fluid.Radius, 96.0f) << "presets stay until the next gesture";
}

TEST_F(InkFrame, tapLastsWhileItsFingerMoves) {
    touch(240, 400, kActionDown, 1.0f);
    touch(241, 401, kActionMove, 1.0f);
    frames(20);
    EXPECT_EQ(std::pair(state, step), std::pair(+kTapping, 20));
    EXPECT_EQ(std::pair(fluid.Previous.x, fluid.Previous.y), std::pair(240.0f, 400.0f))
        << "a segment of the last movement";
    EXPECT_EQ(std::pair(fluid.Current.x, fluid.Current.y), std::pair(241.0f, 399.0f));
    step = kLast - 2;
    count = kLast - 1;
    frames(5);
    EXPECT_EQ(std::pair(state, step), std::pair(+kTapping, kLast)) << "step saturates";
    EXPECT_EQ(count, -kLast + 2) << "count wraps";
    touch(241, 401, kActionUp, 1.0f);
    frames(1);
    EXPECT_EQ(std::pair(state, step), std::pair(+kIdle, 0));
}

TEST_F(InkFrame, dragsApplyThePresetOfTheirSpeed) {
    touch(100, 400, kActionDown, 0.5f);
    touch(103, 400, kActionMove, 0.5f);
    const Preset before = currentPreset();
    frames(1);
    EXPECT_EQ(currentPreset(), before) << "until the first measured movement";
    const float weight = 0.45f;
    int x = 103, y = 400;
    for (const auto& [way, preset] :
         {std::pair(20, Preset{2, 30, 40, 20, 4, 0.96f, 0.92f}),
          {9, Preset{1, 25, 150, 10, 20, 0.94f, 0.92f}},
          {1, Preset{0, 40 * weight, 100, 45 * weight, 20, 0.8f, 0.94f}},
          {11, Preset{2, 30, 40, 20, 4, 0.96f, 0.92f}}}) {
        SCOPED_TRACE(way);
        const std::array segment = {x, 800 - y, x + way, 800 - y - 1};
        touch(x += way, ++y, kActionMove, 0.5f);
        const vec2* const velocity = fluid.VelocityTex.data;
        frames(1);
        EXPECT_EQ(currentPreset(), preset);
        const auto [from, to] = std::pair(fluid.Previous, fluid.Current);
        EXPECT_TRUE(std::ranges::equal(std::array{from.x, from.y, to.x, to.y}, segment)) << "segments join";
        // Update swaps the pair twice, Perturb once more.
        EXPECT_EQ(fluid.VelocityTex.data != velocity, preset[0] == 2);
    }
    EXPECT_EQ(drag_step, 5);
    drag_step = kLast - 2;
    frames(5);
    EXPECT_EQ(drag_step, kLast);
}

TEST_F(InkFrame, hugePressureKeepsTheVelocityFinite) {
    for (const float pressure : {1e18f, std::numeric_limits<float>::infinity()}) {
        for (const int x : {240, 243, 244, 245}) touch(x, 400, x == 240 ? kActionDown : kActionMove, pressure);
        frames(3);
        EXPECT_EQ(TouchPressure, pressure * pressure);
        EXPECT_EQ(fluid.Radius, 40 * TouchPressure);
        EXPECT_EQ(fluid.SourceStrength, 45 * TouchPressure);
        const Texture<vec2>& flow = fluid.VelocityTex;
        const auto isFinite = [](vec2 v) { return std::isfinite(v.x) && std::isfinite(v.y); };
        EXPECT_TRUE(std::all_of(flow.row(0), flow.row(flow.height), isFinite));
        EXPECT_FALSE(std::all_of(flow.row(0), flow.row(flow.height), [](vec2 v) { return v.x == 0; }));
    }
}

TEST_F(InkFrame, inkReturnsWithTheNextTouch) {
    touch(240, 400, kActionDown, 1.0f);
    frames(6);
    EXPECT_GT(maxDensity(), 0);
    native::clearInkValue(hostEnvironment(), nullptr);
    EXPECT_EQ(native::getClearInkValue(hostEnvironment(), nullptr), 0);
    frames(1);
    EXPECT_EQ(maxDensity(), 0);
    EXPECT_EQ((std::array{state, step, fluid.DragMode}), (std::array{0, 0, 0}));

    touch(100, 400, kActionDown, 1.0f);
    EXPECT_EQ(native::getClearInkValue(hostEnvironment(), nullptr), 1);
    touch(120, 400, kActionMove, 1.0f);
    touch(140, 400, kActionMove, 1.0f);
    frames(1);
    Frame::setUp(480, 800, false);
    touch(160, 400, kActionMove, 1.0f);
    Frame::setUp(480, 800, true);
    EXPECT_EQ(maxDensity(), 0);
    touch(180, 400, kActionMove, 1.0f);
    Frame().draw();
    EXPECT_NEAR(fluid.InkColor.r, 0.15f, 1e-6f);
    EXPECT_GT(maxDensity(), 0) << "the stroke continues";
    EXPECT_EQ(std::pair(fluid.Previous.x, fluid.Current.x), std::pair(140.0f, 180.0f));
}
