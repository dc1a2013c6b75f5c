// A host's mistakes must not crash its app. The fuzz target tries any call with any value; these tests cover logging,
// pending exceptions and the behaviour of a real driver.
#include <algorithm>

#include "jni/gesture.h"
#include "probes/gesture_state.h"
#include "tests/support/frame.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

class Misuse : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        resetGestures();
    }

    void drag(int x, int y) {
        for (int i = 0; i < 4; ++i) {
            touch(x + 20 * i, y, i ? kActionMove : kActionDown, 1.0f);
            frame.draw();
        }
    }

    int logged(const std::string& line) { return static_cast<int>(std::ranges::count(log.take(), line)); }

    static void ignoreErrors() {
        while (glGetError() != GL_NO_ERROR) continue;
    }

    static jint move(JNIEnv* from, FloatArray* v, FloatArray* h) {
        return native::move(from, nullptr, v, h, 0, 0, 2, 2, 2, 2, true, 0.9f, 0.3f);
    }

    JNIEnv* const env = copyingEnvironment();
    Frame frame;
};

}  // namespace

TEST_F(Misuse, drawingBeforeSetUpIsSkippedAndLoggedOnce) {
    bWithInk = true;
    drag(100, 100);
    native::onInitGPU(env, nullptr);  // Without onInitSetting the ink has no texels.
    frame.draw();
    static int times = 0;
    EXPECT_EQ(times += logged("E Ripple_Render() without the buffers of onInitSetting()"), 1) << "once per process";
    ignoreErrors();
}

TEST_F(Misuse, callWithAMissingArrayDoesNothing) {
    static int gets, getToFail;
    static JNINativeInterface_ functions = *env->functions;
    functions.GetFloatArrayElements = [](JNIEnv*, jfloatArray array, jboolean* isCopy) -> jfloat* {
        return ++gets == getToFail ? nullptr : copyingEnvironment()->GetFloatArrayElements(array, isCopy);
    };
    JNIEnv failing = {&functions};
    Frame::setUp(kSide, kSide, true);
    frame.height.values = frame.velocity.values = {1, 2, 3, 4};
    log.take();
    for (int i = 0; i < 2; ++i) {
        native::initWaters(env, nullptr, nullptr, &frame.indices, 4, 1, 1, 2, 2);
        native::initWaters(env, nullptr, &frame.positions, nullptr, 4, 1, 1, 2, 2);
        EXPECT_TRUE(move(env, nullptr, &frame.height));
        EXPECT_TRUE(move(env, &frame.velocity, nullptr));
        native::ripple(env, nullptr, nullptr, 1, 1, 9, 9, 0.0f, 0.0f, 1.0f);
        Frame::draw(env, nullptr, &frame.heights, &frame.indices, &frame.mvp);
        Frame::draw(env, &frame.positions, nullptr, &frame.indices, &frame.mvp);
        Frame::draw(env, &frame.positions, &frame.heights, nullptr, &frame.mvp);
        Frame::draw(env, &frame.positions, &frame.heights, &frame.indices, nullptr);
        // The VM has no memory for the second copy.
        gets = 0;
        getToFail = 2;
        EXPECT_TRUE(move(&failing, &frame.velocity, &frame.height));
        EXPECT_EQ(gets, 2);
        gets = 0;
        frame.draw(&failing);
        EXPECT_EQ(gets, 2) << "no further array may be pinned while an exception is pending";
    }
    EXPECT_EQ(pinnedCopies, 0) << "every pinned array is released";
    EXPECT_EQ(binding(GL_ELEMENT_ARRAY_BUFFER_BINDING), 0) << "nothing was drawn";
    EXPECT_EQ(frame.height.values, (std::vector<float>{1, 2, 3, 4}));
    EXPECT_EQ(frame.velocity.values, frame.height.values);
    EXPECT_EQ(frame.indices.values, std::vector<short>(6));
    EXPECT_EQ(count, 10) << "the ink is still stepped";
    static std::vector<std::string> lines;
    std::ranges::copy(log.take(), std::back_inserter(lines));
    const std::vector<std::string> expected = {
        "E initWaters() without an array", "E move() without an array", "E ripple() without an array",
        "E onDrawFrame() without an array"};
    EXPECT_EQ(lines, expected) << "each once per process";
}

TEST_F(Misuse, unusedNullArraysAndAFailedProgramDoNotPreventADraw) {
    Frame::setUp(kSide, kSide, true);
    Frame::draw(env, nullptr, nullptr, nullptr, &frame.mvp, 0);
    EXPECT_EQ(binding(GL_ELEMENT_ARRAY_BUFFER_BINDING), static_cast<int>(fluid.i_buf));
    fluid.ripple_program = 0;
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, 0);
    frame.draw();
    EXPECT_EQ(binding(GL_ELEMENT_ARRAY_BUFFER_BINDING), static_cast<int>(fluid.i_buf));
    EXPECT_EQ(binding(GL_CURRENT_PROGRAM), 0);
    ignoreErrors();
}

// Runs on a real driver, which may crash on invalid calls. A valid set-up recovers from all of them.
TEST_F(Misuse, anyViewAndSetUpOrderIsSafe) {
    for (const auto& [width, height] :
         {std::pair(0, 0), {1, 1}, {11, 4000}, {0, 64}, {-5, 64}, {-7, -100}, {16384, 16384}}) {
        Frame::setUp(width, height, true);
        drag(width / 2, height / 2);
    }
    // A grid that no machine has memory for, and one with columns beyond the exact integers of a float.
    for (const auto& [width, height, grid] :
         {std::tuple(2000000000, 2000000000, "166666666 x 166666666"), {2147483647, 12, "178956970 x 1"}}) {
        log.take();
        Frame::setUp(width, height, true);
        EXPECT_EQ(logged(std::string("E no memory for an ink grid of ") + grid), 1);
        drag(1000000, 6);
        EXPECT_TRUE(log.take().empty()) << "the water is still drawn";
    }
    // Incomplete set-ups, in the other mode or in the wrong order, without pictures.
    native::onLoadWaterTextures(env, nullptr);
    native::onInitSetting(env, nullptr, 200, 100, true);
    drag(200, 100);
    Frame::setUp(100, 200, false);
    native::onInitSetting(env, nullptr, 100, 200, true);
    drag(100, 200);
    ignoreErrors();
    renewContext();
    drag(100, 200);
    ignoreErrors();
    for (const bool withInk : {false, true}) Frame::setUp(480, 800, withInk);
    ignoreErrors();
    const GLuint ping = fluid.Density.Ping.TextureHandle;
    touch(240, 400, kActionDown, 1.0f);
    frame.draw();
    EXPECT_EQ(fluid.Density.Ping.TextureHandle, ping) << "advection and injection each swap the pair";
}
