#include "jni/ink_frame.h"

#include <algorithm>

#include "host/host_jni.h"
#include "host/native_names.h"
#include "jni/gesture.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "water/waves.h"

namespace {

class InkFrame : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        start(480, 800);
    }

    void start(int width, int height) {
        resetGestures();
        fluid.InitializeSetting(width, height, true);
        fluid.InitializeGPU(true);
        log.take();
        srand48(3);
    }

    static void frame() { stepInk({0.0f, 0.1f, 0.2f}); }

    static void frames(int n) {
        for (int i = 0; i < n; ++i) frame();
    }

    // Rows from the bottom, 255 steps a unit.
    static std::vector<int> density() {
        glBindFramebuffer(GL_FRAMEBUFFER, fluid.Density.Ping.FboHandle);
        std::vector<int> values;
        for (const Rgba& texel : readPixels(fluid.InkWidth, fluid.InkHeight))
            values.push_back(texel[0] * 255 + texel[1]);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return values;
    }

    static long total() {
        long sum = 0;
        for (const int value : density()) sum += value;
        return sum;
    }
};

}  // namespace

TEST_F(InkFrame, aTapGrowsForTenFramesAndEndsAfterThirteen) {
    touch(240, 400, 0, 1.0f);
    for (int i = 0; i <= 12; ++i) {
        SCOPED_TRACE(i);
        ASSERT_EQ(state, 1);
        ASSERT_EQ(step, i);
        const GLuint ping = fluid.Density.Ping.TextureHandle;
        const float backward = fluid.BackwardStepSize;
        fluid.TimeStep = 0.5f;
        frame();
        float uploaded = -1.0f;
        glGetUniformfv(
            fluid.advect_density_program, glGetUniformLocation(fluid.advect_density_program, "BackwardStepSize"),
            &uploaded);
        EXPECT_EQ(uploaded, backward) << "the update works with what the last frame left";
        EXPECT_EQ(fluid.TimeStep, 0.25f);
        EXPECT_EQ(fluid.ImpulseDensity, 200.0f);
        EXPECT_EQ(fluid.DragMode, -1);
        EXPECT_EQ(fluid.Radius, 8.0f * static_cast<float>(i));
        EXPECT_EQ(fluid.SourceStrength, i < 5 ? 12.0f * static_cast<float>(i) : 0.0f);
        EXPECT_EQ(fluid.SourceRadius, 40.0f);
        EXPECT_EQ(fluid.VelocityDissipation, 0.94f);
        EXPECT_EQ(fluid.DensityDissipation, 0.92f);
        EXPECT_EQ(fluid.BackwardStepSize, i < 10 ? 0.1f * static_cast<float>(i) : 1.0f) << "in single precision";
        EXPECT_EQ(fluid.Density.Ping.TextureHandle == ping, i < 10) << "an injection swaps once more";
        EXPECT_EQ(total() > 0, i > 0) << "a radius of 0 adds nothing";
    }
    EXPECT_EQ(state, 0);
    EXPECT_EQ(step, 0);
    EXPECT_EQ(count, 13);
    EXPECT_EQ(fluid.InkColor.r, static_cast<float>(0.05));
    EXPECT_EQ(fluid.InkColor.b, static_cast<float>(double{0.2f} + 0.05));
    EXPECT_EQ(fluid.InkIntensity, 0.02f);
    EXPECT_EQ(fluid.InkColorOffset, 0.7f);
    frames(200);
    // 0.92 of six 255ths or less rounds to itself; the picture's 8 bits show less than a hundredth of a level of that.
    EXPECT_LE(std::ranges::max(density()), 6) << "and the blot fades away";
    EXPECT_EQ(fluid.Radius, 96.0f) << "presets stay until the next gesture";
}

TEST_F(InkFrame, aTapWhoseFingerStillMovesDoesNotEnd) {
    touch(240, 400, 0, 1.0f);
    touch(241, 400, 2, 1.0f);
    frames(20);
    EXPECT_EQ(state, 1);
    EXPECT_EQ(step, 20);
    touch(241, 400, 1, 1.0f);
    frame();
    EXPECT_EQ(state, 0);
    touch(240, 400, 0, 1.0f);
    touch(242, 401, 2, 1.0f);
    frame();
    EXPECT_EQ(fluid.Previous.x, 240.0f) << "a tap's segment is its last movement";
    EXPECT_EQ(fluid.Previous.y, 400.0f);
    EXPECT_EQ(fluid.Current.x, 242.0f);
}

TEST_F(InkFrame, dragsWriteThePresetOfTheirSpeed) {
    touch(100, 400, 0, 0.5f);
    touch(103, 400, 2, 0.5f);
    frame();
    EXPECT_EQ(fluid.Radius, 2.0f) << "before the first measured movement the parameters stay";
    EXPECT_EQ(fluid.DragMode, 0);
    struct Row {
        int way, mode;
        float radius, density, strength, sourceRadius, velocity, ink;
    };
    const float weight = 0.45f;
    int x = 103;
    for (const Row& row :
         {Row{20, 2, 30, 40, 20, 4, 0.96f, 0.92f},
          {9, 1, 25, 150, 10, 20, 0.94f, 0.92f},
          {2, 0, 40 * weight, 100, 45 * weight, 20, 0.8f, 0.94f},
          {11, 2, 30, 40, 20, 4, 0.96f, 0.92f}}) {
        SCOPED_TRACE(row.way);
        const int start = x;
        x += row.way;
        touch(x, 400, 2, 0.5f);
        const vec2* const before = fluid.VelocityTex.data;
        frame();
        EXPECT_EQ(fluid.DragMode, row.mode);
        EXPECT_FLOAT_EQ(fluid.Radius, row.radius);
        EXPECT_EQ(fluid.ImpulseDensity, row.density);
        EXPECT_FLOAT_EQ(fluid.SourceStrength, row.strength);
        EXPECT_EQ(fluid.SourceRadius, row.sourceRadius);
        EXPECT_EQ(fluid.VelocityDissipation, row.velocity);
        EXPECT_EQ(fluid.DensityDissipation, row.ink);
        EXPECT_EQ(fluid.Previous.x, static_cast<float>(start)) << "segments join";
        EXPECT_EQ(fluid.Current.x, static_cast<float>(x));
        // Two swaps of the pair in Update; a push adds a third.
        EXPECT_EQ(fluid.VelocityTex.data != before, row.mode == 2);
    }
    EXPECT_EQ(drag_step, 5);
    touch(x, 400, 3, 0.5f);
    EXPECT_EQ(NATIVE(getClearInkValue)(hostEnvironment(), nullptr), 0);
}

TEST_F(InkFrame, slowMediumAndFastStrokesLayDifferentTrails) {
    const auto trailOf = [this](int way) {
        start(480, 800);
        touch(100, 400, 0, 1.0f);
        for (int x = 100; x < 380; x += way) {
            touch(x, 400, 2, 1.0f);
            frame();
        }
        const auto d = density();
        // Rows of the trail at its last third that hold ink.
        int rows = 0;
        for (int j = 0; j < fluid.InkHeight; ++j)
            rows += d[static_cast<std::size_t>(j * fluid.InkWidth + 185)] > 2 * 255;
        return std::pair(rows, total());
    };
    const auto slow = trailOf(2);
    const auto medium = trailOf(8);
    const auto fast = trailOf(20);
    EXPECT_GT(slow.first, 2 * medium.first) << "slow strokes are wide";
    EXPECT_GT(medium.first, 4);
    EXPECT_GT(fast.first, 4);
    EXPECT_GT(slow.second, medium.second);
    EXPECT_NE(medium.second, fast.second);
}

TEST_F(InkFrame, clearingTakesOneFrameAndTheNextTouchBringsInkBack) {
    touch(240, 400, 0, 1.0f);
    frames(6);
    EXPECT_GT(total(), 0);
    NATIVE(clearInkValue)(hostEnvironment(), nullptr);
    frame();
    EXPECT_EQ(total(), 0);
    EXPECT_EQ(state, 0);
    touch(240, 400, 0, 1.0f);
    frames(4);
    EXPECT_GT(total(), 0);
}

TEST_F(InkFrame, theSameScriptGivesTheSameInkAlsoAfterALostContext) {
    const auto run = [this] {
        start(480, 800);
        touch(200, 300, 0, 1.0f);
        for (int i = 0; i < 25; ++i) {
            touch(200 + 5 * i, 300 + 9 * i, 2, 0.7f);
            frame();
        }
        return density();
    };
    const auto once = run();
    EXPECT_EQ(run(), once);

    touch(300, 500, 2, 1.0f);
    renewContext();
    fluid.InitializeSetting(480, 800, true);
    fluid.InitializeGPU(true);
    EXPECT_EQ(total(), 0) << "the ink was the lost context's";
    EXPECT_EQ(state, 2) << "the stroke goes on";
    touch(330, 500, 2, 1.0f);
    frames(2);
    EXPECT_GT(total(), 0);
    EXPECT_EQ(run(), once);
}

TEST_F(InkFrame, anyViewIsSafeAndTheInkMaySwitchOnAndOff) {
    for (const auto& [width, height] :
         {std::pair{1, 1}, {11, 11}, {0, 0}, {12, 5}, {30, 500}, {-7, -100}, {800, 480}}) {
        SCOPED_TRACE(testing::Message() << width << " x " << height);
        start(width, height);
        touch(width / 2, height / 2, 0, 1.0f);
        frames(3);
        touch(width / 2 + 20, height / 2, 2, 1.0f);
        touch(width / 2 + 50, height / 2, 2, 1.0f);
        frames(3);
        NATIVE(onInitSetting)(hostEnvironment(), nullptr, width, height, JNI_FALSE);
        NATIVE(onInitGPU)(hostEnvironment(), nullptr);
        while (glGetError() != GL_NO_ERROR) continue;
    }
    start(480, 800);
    touch(240, 400, 0, 1.0f);
    frames(4);
    EXPECT_GT(total(), 0);
}

TEST_F(InkFrame, theWaterGoesOnWithoutAGrid) {
    // More texels than any machine has memory for; and a grid longer than floats can count.
    for (const auto& [width, height_] : {std::pair{2000000000, 2000000000}, {2147483647, 12}}) {
        fluid.InitializeSetting(width, height_, true);
        fluid.InitializeGPU(true);
        const auto lines = log.take();
        const std::string expected =
            "E no memory for an ink grid of " + std::to_string(width / 12) + " x " + std::to_string(height_ / 12);
        EXPECT_EQ(std::count(lines.begin(), lines.end(), expected), 1);
        EXPECT_EQ(fluid.VelocityTex.data, nullptr);
        EXPECT_EQ(fluid.DivergenceTex.data, nullptr);
        touch(1000000, 6, 0, 1.0f);
        frames(3);
        touch(1000100, 6, 2, 1.0f);
        touch(1000200, 6, 2, 1.0f);
        frames(3);
        EXPECT_TRUE(log.take().empty());
        while (glGetError() != GL_NO_ERROR) continue;
    }
    start(480, 800);
    touch(240, 400, 0, 1.0f);
    frames(4);
    EXPECT_GT(total(), 0) << "the next set-up recovers";
}
