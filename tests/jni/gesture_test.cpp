#include "jni/gesture.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <vector>

#include "tests/support/gesture_state.h"

namespace {

enum { kDown, kUp, kMove, kCancel, kOther = 9 };

// One event and what it leaves behind.
struct Row {
    int x, y, action;
    int state, step, dragStep, speed;
    float shown;
    // Frames that the ink step would count before this event.
    int tapFrames = 0;
    int dragFrames = 0;
};

void play(const char* name, const std::vector<Row>& rows) {
    resetGestures();
    int event = 0;
    for (const Row& row : rows) {
        SCOPED_TRACE(testing::Message() << name << ", event " << event++);
        step += row.tapFrames;
        drag_step += row.dragFrames;
        touch(row.x, row.y, row.action, 0.5f);
        EXPECT_EQ(state, row.state);
        EXPECT_EQ(step, row.step);
        EXPECT_EQ(drag_step, row.dragStep);
        EXPECT_EQ(isMovingEvent, row.speed);
        EXPECT_EQ(fluid.ClearInkValue, row.shown);
        EXPECT_EQ(PREV_POSITION_X, row.x);
        EXPECT_EQ(PREV_POSITION_Y, row.y);
        EXPECT_EQ(TOUCH_ACTION, row.action);
    }
}

}  // namespace

TEST(Gesture, followsItsTransitionTable) {
    //                       x   y  action  state step drag speed shown tap drag
    play(
        "idle", {{5, 5, kUp, 0, 0, 0, -1, 1},
                 {5, 5, kMove, 0, 0, 0, -1, 1},
                 {5, 5, kOther, 0, 0, 0, -1, 1},
                 {5, 5, kCancel, 0, 0, 0, -1, 0}});
    play(
        "a tap keeps its finger within two pixels", {{50, 50, kDown, 1, 0, 0, -1, 1},
                                                     {52, 50, kMove, 1, 3, 0, -1, 1, 3},
                                                     {50, 50, kMove, 1, 3, 0, -1, 1},
                                                     {50, 50, kOther, 1, 3, 0, -1, 1},
                                                     {50, 50, kUp, 1, 3, 0, -1, 1},
                                                     {60, 60, kDown, 1, 1, 0, -1, 1},
                                                     {60, 60, kCancel, 0, 0, 0, -1, 0}});
    play(
        "a longer way makes it a drag", {{50, 50, kDown, 1, 0, 0, -1, 1},
                                         {52, 52, kMove, 2, 0, 0, -1, 1, 0, 7},
                                         {54, 52, kMove, 2, 0, 4, 0, 1, 0, 4},
                                         {57, 52, kMove, 2, 0, 4, 1, 1},
                                         {67, 52, kMove, 2, 0, 4, 1, 1},
                                         {67, 63, kMove, 2, 0, 4, 2, 1},
                                         {67, 63, kDown, 2, 0, 4, 0, 1},
                                         {80, 63, kOther, 2, 0, 4, 2, 1},
                                         {81, 63, kCancel, 0, 0, 4, 0, 0}});
    play(
        "so does any movement once its time is over",
        {{50, 50, kDown, 1, 0, 0, -1, 1}, {50, 50, kMove, 1, 11, 0, -1, 1, 11}, {50, 50, kMove, 2, 12, 0, -1, 1, 1}});
    play(
        "a drag of a moment goes on as the tap that it was", {{50, 50, kDown, 1, 0, 0, -1, 1},
                                                              {59, 50, kMove, 2, 3, 0, -1, 1, 3},
                                                              {59, 50, kUp, 1, 3, 9, 0, 1, 0, 9},
                                                              {59, 59, kMove, 2, 3, 0, 0, 1}});
    play(
        "a longer one ends",
        {{50, 50, kDown, 1, 0, 0, -1, 1}, {59, 50, kMove, 2, 3, 0, -1, 1, 3}, {59, 50, kUp, 0, 0, 0, 0, 1, 0, 10}});
    play(
        "and one whose tap was over",
        {{50, 50, kDown, 1, 0, 0, -1, 1}, {50, 50, kMove, 2, 12, 0, -1, 1, 12}, {50, 50, kUp, 0, 0, 0, 0, 1, 0, 1}});
}

TEST(Gesture, theReleaseOfADragLeavesTheInkToFade) {
    play("drag", {{50, 50, kDown, 1, 0, 0, -1, 1}, {59, 50, kMove, 2, 3, 0, -1, 1, 3}});
    fluid.SourceStrength = 45.0f;
    drag_step = 10;
    touch(59, 50, kUp, 1.0f);
    EXPECT_EQ(fluid.SourceStrength, 0.0f);
    EXPECT_EQ(fluid.VelocityDissipation, 0.9f);
    EXPECT_EQ(fluid.DensityDissipation, 0.9f);
}

TEST(Gesture, measuresMovementsOnlyInsideAGesture) {
    play("down", {{50, 60, kDown, 1, 0, 0, -1, 1}});
    EXPECT_EQ(DRAG_START_X, 50);
    EXPECT_EQ(DRAG_END_Y, 60);
    EXPECT_EQ(DX, 0) << "the way to a touch-down is no movement";
    count = 7;
    touch(57, 40, kMove, 1.0f);
    EXPECT_EQ(DX, 7);
    EXPECT_EQ(DY, -20);
    EXPECT_EQ(DRAG_START_X, 50) << "the frame moves the segment, not the touch";
    EXPECT_EQ(count, 7);
    touch(57, 40, kCancel, 1.0f);
    touch(9, 9, kDown, 1.0f);
    touch(10, 9, kMove, 1.0f);
    touch(60, 9, kCancel, 1.0f);
    touch(9, 9, kMove, 1.0f);
    EXPECT_EQ(DX, 1) << "a cancelled tap is not measured, nor is a movement without a gesture";
    touch(9, 9, kDown, 1.0f);
    touch(20, 30, kDown, 1.0f);
    EXPECT_EQ(DRAG_START_X, 20) << "a second touch-down starts anew";
    EXPECT_EQ(DRAG_END_Y, 30);
    touch(9, 9, kCancel, 1.0f);
    EXPECT_EQ(POSITION_X, 9);
    touch(9, 9, kDown, 1.0f);
    EXPECT_EQ(count, 0);
}

TEST(Gesture, weighsThePressureAndTakesAnyValue) {
    const float inf = std::numeric_limits<float>::infinity();
    const auto weightOf = [](float pressure) {
        resetGestures();
        touch(1, 1, kDown, pressure);
        return TouchPressure;
    };
    EXPECT_FLOAT_EQ(weightOf(1.0f), 1.2f);
    // The sum is rounded once, from the single-precision 0.2 widened; these two tell it from a double 0.2.
    EXPECT_EQ(weightOf(0.1f), static_cast<float>(double{0.1f} * double{0.1f} + double{0.2f}));
    EXPECT_EQ(weightOf(0.0001f), std::nextafter(0.2f, 1.0f));
    for (const float none : {0.0f, -1.0f, -inf, std::nanf("")}) EXPECT_EQ(weightOf(none), 0.0f);
    EXPECT_EQ(weightOf(inf), inf);

    const int most = std::numeric_limits<int>::max();
    const int least = std::numeric_limits<int>::min();
    for (const int far : {most, least}) {
        touch(far, -1, kDown, 1.0f);
        touch(-1, far, kMove, 1.0f);
        touch(far, far, kUp, 1.0f);
    }
}
