// What a host gets wrong must not take its app down.
#include <algorithm>
#include <cmath>
#include <limits>
#include <utility>

#include "fluid/fluid.h"
#include "host/host_jni.h"
#include "host/native_names.h"
#include "host/water_host.h"
#include "jni/gesture.h"
#include "jni/globals.h"
#include "jni/ink_frame.h"
#include "platform/desktop_bitmap.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tests/support/test_pictures.h"

namespace {

constexpr float kInfinity = std::numeric_limits<float>::infinity();

struct Arrays {
    FloatArray positions{12}, heights{4}, attribs{12}, mvp{16}, velocity{4};
    ShortArray indices{6};
    int pins() const { return positions.pins + heights.pins + attribs.pins + mvp.pins + velocity.pins + indices.pins; }
};

void draw(JNIEnv* env, FloatArray* positions, FloatArray* attribs, ShortArray* indices, FloatArray* mvp) {
    NATIVE(onDrawFrame)
    (env, nullptr, positions, attribs, indices, 12, 12, 6, mvp, 1, 1, 2, 2, 1.33f, 0.5f, 0.5f, 1.0f, 0.0f, 0.0f, 0.0f,
     1.0f, 1.0f, 40.0f, false);
}

class Misuse : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        resetGestures();
    }
};

}  // namespace

TEST_F(Misuse, nothingHappensBeforeSetUp) {
    JNIEnv* const env = hostEnvironment();
    Arrays a;
    bWithInk = true;
    NATIVE(onTouch)(env, nullptr, 100, 100, 0, 1.0f);
    for (int i = 0; i < 20; ++i) {
        NATIVE(onTouch)(env, nullptr, 100 + 20 * i, 100, 2, 1.0f);
        draw(env, &a.positions, &a.attribs, &a.indices, &a.mvp);
    }
    EXPECT_EQ(glGetError(), static_cast<GLenum>(GL_NO_ERROR));
    NATIVE(onInitGPU)(env, nullptr);  // half a set-up, whose ink has no texels
    draw(env, &a.positions, &a.attribs, &a.indices, &a.mvp);
    NATIVE(clearInkValue)(env, nullptr);
    EXPECT_EQ(NATIVE(getClearInkValue)(env, nullptr), 0);
    const auto lines = log.take();
    EXPECT_EQ(std::ranges::count(lines, "E Ripple_Render() without a set-up"), 1) << "not in every frame";
    while (glGetError() != GL_NO_ERROR) {
    }
}

TEST_F(Misuse, aNullArrayMakesTheCallDoNothing) {
    JNIEnv* const env = hostEnvironment();
    WaterHost host(Look(), 120, 120, 1);
    host.handOver({smoothPicture(8, 8, 1), smoothPicture(8, 8, 2), smoothPicture(8, 8, 3)});
    host.setUp(true);
    log.take();
    Arrays a;
    a.heights.values = {1, 2, 3, 4};
    const int framesBefore = count;
    const auto initWaters = [&](FloatArray* p, ShortArray* i) {
        NATIVE(initWaters)(env, nullptr, p, i, 4, 1, 1, 2, 2);
    };
    const auto move = [&](FloatArray* v, FloatArray* h) {
        return NATIVE(move)(env, nullptr, v, h, 0, 0, 2, 2, 2, 2, true, 0.9f, 0.3f);
    };
    initWaters(nullptr, &a.indices);
    initWaters(&a.positions, nullptr);
    EXPECT_TRUE(move(nullptr, &a.heights));
    EXPECT_TRUE(move(&a.velocity, nullptr));
    NATIVE(ripple)(env, nullptr, nullptr, 1, 1, 9, 9, 0.0f, 0.0f, 1.0f);
    draw(env, nullptr, &a.attribs, &a.indices, &a.mvp);
    draw(env, &a.positions, nullptr, &a.indices, &a.mvp);
    draw(env, &a.positions, &a.attribs, nullptr, &a.mvp);
    draw(env, &a.positions, &a.attribs, &a.indices, nullptr);
    EXPECT_EQ(a.pins(), 0) << "what was pinned is released";
    EXPECT_EQ(a.heights.values, (std::vector<float>{1, 2, 3, 4}));
    EXPECT_EQ(a.indices.values, std::vector<short>(6));
    EXPECT_EQ(count, framesBefore) << "no ink step without a picture";
    const std::vector<std::string> expected = {
        "E initWaters() without an array", "E move() without an array", "E ripple() without an array",
        "E onDrawFrame() without an array"};
    EXPECT_EQ(log.take(), expected) << "each once";
}

// A virtual machine without memory for the second copy that it is asked for.
TEST_F(Misuse, anArrayThatCannotBePinnedMakesTheCallDoNothing) {
    static int gets;
    static JNINativeInterface_ functions = *hostEnvironment()->functions;
    functions.GetFloatArrayElements = [](JNIEnv*, jfloatArray array, jboolean* isCopy) -> jfloat* {
        return ++gets == 2 ? nullptr : hostEnvironment()->GetFloatArrayElements(array, isCopy);
    };
    JNIEnv env = {&functions};
    Arrays a;
    a.velocity.values = {1, 2, 3, 4};
    EXPECT_TRUE(NATIVE(move)(&env, nullptr, &a.velocity, &a.heights, 0, 0, 2, 2, 2, 2, true, 0.9f, 0.3f));
    EXPECT_EQ(gets, 2);
    gets = 0;
    draw(&env, &a.positions, &a.attribs, &a.indices, &a.mvp);
    EXPECT_EQ(gets, 2) << "an exception is pending: no further array may be asked for";
    EXPECT_EQ(a.pins(), 0);
    EXPECT_EQ(a.velocity.values, (std::vector<float>{1, 2, 3, 4}));
}

TEST_F(Misuse, absurdCountsWriteNothing) {
    constexpr int kMin = std::numeric_limits<int>::min();
    constexpr int kMax = std::numeric_limits<int>::max();
    JNIEnv* const env = hostEnvironment();
    Arrays a;
    for (const int n : {kMin, -1, 0}) {
        NATIVE(initWaters)(env, nullptr, &a.positions, &a.indices, 4, 1, 1, n, 2);
        NATIVE(initWaters)(env, nullptr, &a.positions, &a.indices, 4, 1, 1, 2, n);
        NATIVE(ripple)(env, nullptr, &a.heights, 1, 1, n, 9, 0.0f, 0.0f, 1.0f);
        NATIVE(ripple)(env, nullptr, &a.heights, 1, 1, 9, n, 0.0f, 0.0f, 1.0f);
    }
    EXPECT_TRUE(NATIVE(move)(env, nullptr, &a.velocity, &a.heights, kMax, 0, kMin, 2, 2, 2, true, 0.9f, 0.3f));
    EXPECT_TRUE(NATIVE(move)(env, nullptr, &a.velocity, &a.heights, 0, kMax, 2, kMin, 2, 2, true, 0.9f, 0.3f));
    EXPECT_EQ(a.positions.values, std::vector<float>(12));
    EXPECT_EQ(a.heights.values, std::vector<float>(4));
    EXPECT_EQ(a.indices.values, std::vector<short>(6));
}

TEST_F(Misuse, anyViewAndAnyOrderOfSetUpIsSurvived) {
    JNIEnv* const env = hostEnvironment();
    Arrays a;
    const auto initSetting = [&](int width, int height, bool withInk) {
        NATIVE(onInitSetting)(env, nullptr, width, height, withInk);
    };
    const auto gesture = [&](int width, int height) {
        for (int i = 0; i < 4; ++i) {
            NATIVE(onTouch)(env, nullptr, width / 2 + 20 * i, height / 2, i ? 2 : 0, 1.0f);
            draw(env, &a.positions, &a.attribs, &a.indices, &a.mvp);
        }
    };
    for (const auto& [width, height] :
         {std::pair(0, 0), {1, 1}, {11, 4000}, {0, 64}, {-5, 64}, {16384, 16384}, {64, 64}}) {
        initSetting(width, height, true);
        NATIVE(onInitGPU)(env, nullptr);
        gesture(width, height);
    }
    // The pictures were never handed over, and the set-up stops half-way, in the other mode, or starts at its end.
    NATIVE(onLoadWaterTextures)(env, nullptr);
    initSetting(200, 100, true);
    gesture(200, 100);
    initSetting(100, 200, false);
    NATIVE(onInitGPU)(env, nullptr);
    initSetting(100, 200, true);
    gesture(100, 200);
    renewContext();
    gesture(100, 200);
    NATIVE(onInitGPU)(env, nullptr);
    gesture(100, 200);
    while (glGetError() != GL_NO_ERROR) {
    }
}

TEST_F(Misuse, waterShowsWhenTheInkGoesBeforeItsFirstFrame) {
    WaterHost host(Look(), kSide, kSide, 1);
    host.handOver({smoothPicture(8, 8, 1), smoothPicture(8, 8, 2), smoothPicture(8, 8, 3)});
    host.setUp(false);
    host.draw();
    const auto water = readPixels();
    glClear(GL_COLOR_BUFFER_BIT);
    host.setUp(true);
    host.setUp(false);
    host.draw();
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
    EXPECT_EQ(readPixels(), water);
}

TEST_F(Misuse, noPressureBreaksTheFlow) {
    for (const float pressure : {kInfinity, -kInfinity, std::nanf(""), 3.0e38f, -1.0f, 1000.0f}) {
        SCOPED_TRACE(pressure);
        resetGestures();
        fluid.InitializeSetting(240, 240, true);
        fluid.InitializeGPU(true);
        touch(120, 120, 0, pressure);
        touch(124, 120, 2, pressure);
        for (int i = 0; i < 20; ++i) {
            touch(125 + i % 2, 120, 2, pressure);
            stepInk({});
        }
        ASSERT_EQ(fluid.DragMode, 0) << "a slow drag weighs its pressure";
        if (pressure == 1000.0f) {
            EXPECT_FLOAT_EQ(fluid.Radius, 40.0f * 1000000.2f);
            EXPECT_FLOAT_EQ(fluid.SourceStrength, 45.0f * 1000000.2f);
        }
        for (int i = 0; i < 20 * 20; ++i) {
            const vec2 v = fluid.VelocityTex.data[i];
            ASSERT_TRUE(std::isfinite(v.x) && std::isfinite(v.y)) << i;
        }
    }
}
