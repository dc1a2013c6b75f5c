// A finger that rests for years: the counters of frames at the end of their type.
#include <gtest/gtest.h>

#include <limits>

#include "fluid/fluid.h"
#include "jni/gesture.h"
#include "jni/globals.h"
#include "jni/ink_frame.h"
#include "tests/support/gesture_state.h"
#include "tests/support/log_recorder.h"

namespace {

constexpr int kLast = std::numeric_limits<int>::max();

class FrameCounters : public testing::Test {
protected:
    void SetUp() override {
        resetGestures();
        fluid.InitializeSetting(240, 240, true);
        fluid.InitializeGPU(true);
    }

    static void frames(int number) {
        for (int i = 0; i < number; ++i) stepInk({0.1f, 0.1f, 0.1f});
    }

    // A tap ends by itself as ever.
    static void expectAnOrdinaryTap() {
        touch(120, 120, 0, 1.0f);
        EXPECT_EQ(count, 0);
        touch(120, 120, 1, 1.0f);
        frames(max_step);
        EXPECT_EQ(state, 1);
        frames(1);
        EXPECT_EQ(state, 0);
        EXPECT_EQ(step, 0);
        EXPECT_EQ(count, max_step + 1);
    }

    LogRecorder log;
};

}  // namespace

TEST_F(FrameCounters, aTapUnderAFingerThatNeverLeavesStopsAtTheLastFrame) {
    touch(120, 120, 0, 1.0f);
    touch(121, 120, 2, 1.0f);
    frames(1);
    step = kLast - 2;
    frames(5);
    EXPECT_EQ(state, 1);
    EXPECT_EQ(step, kLast);
    touch(121, 120, 1, 1.0f);
    frames(1);
    EXPECT_EQ(state, 0);
    EXPECT_EQ(step, 0);
    expectAnOrdinaryTap();
}

TEST_F(FrameCounters, aDragThatNeverEndsStopsAtTheLastFrame) {
    touch(120, 120, 0, 1.0f);
    touch(130, 120, 2, 1.0f);
    touch(131, 120, 2, 1.0f);
    drag_step = kLast - 2;
    frames(5);
    EXPECT_EQ(state, 2);
    EXPECT_EQ(drag_step, kLast);
    touch(131, 120, 1, 1.0f);
    EXPECT_EQ(state, 0) << "it was a long drag, and no tap";
    expectAnOrdinaryTap();
}

TEST_F(FrameCounters, theFramesSinceATouchBeginAgain) {
    count = kLast - 2;
    frames(5);
    EXPECT_EQ(count, std::numeric_limits<int>::min() + 2);
    expectAnOrdinaryTap();
}
