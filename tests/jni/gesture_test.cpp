#include "jni/gesture.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <limits>
#include <vector>

#include "fluid/ink_tuning.h"
#include "probes/gesture_state.h"

namespace {

static_assert(kActionDown == 0 && kActionUp == 1 && kActionMove == 2 && kActionCancel == 3);
constexpr int kOther = 9;

// A touch event and the expected state after it.
struct Row {
    int addSteps = 0;  // frames between the previous event and this one
    int x = 50, y = 50, action = kActionDown;
    int state = kIdle, step = 0, dragStep = 0, speed = kTap;
    float shown = 1.0f;
};

struct Gesture {
    const char* name;
    std::vector<Row> rows;
};

const Gesture kGestures[] = {
    {"only a touch-down starts a gesture",
     {{.action = kActionUp}, {.action = kActionMove}, {.action = kOther}, {.action = kActionCancel, .shown = 0}}},
    {"a movement of two pixels stays a tap",
     {{.action = kActionDown, .state = kTapping},
      {.addSteps = 3, .x = 52, .action = kActionMove, .state = kTapping, .step = 3},
      {.action = kActionMove, .state = kTapping, .step = 3},
      {.action = kOther, .state = kTapping, .step = 3},
      {.action = kActionUp, .state = kTapping, .step = 3},
      {.x = 60, .action = kActionDown, .state = kTapping, .step = 1},
      {.x = 90, .action = kActionCancel, .shown = 0}}},
    {"a longer movement starts a drag with a speed class",
     {{.action = kActionDown, .state = kTapping},
      {.x = 52, .y = 52, .action = kActionMove, .state = kDragging},
      {.addSteps = 4, .x = 54, .y = 52, .action = kActionMove, .state = kDragging, .dragStep = 4, .speed = kSlowDrag},
      {.x = 57, .y = 52, .action = kActionMove, .state = kDragging, .dragStep = 4, .speed = kMediumDrag},
      {.x = 67, .y = 52, .action = kActionMove, .state = kDragging, .dragStep = 4, .speed = kMediumDrag},
      {.x = 67, .y = 63, .action = kActionMove, .state = kDragging, .dragStep = 4, .speed = kFastDrag},
      {.x = 67, .y = 63, .action = kActionDown, .state = kDragging, .dragStep = 4, .speed = kSlowDrag},
      {.x = 80, .y = 63, .action = kOther, .state = kDragging, .dragStep = 4, .speed = kFastDrag},
      {.x = 81, .y = 63, .action = kActionCancel, .dragStep = 4, .speed = kSlowDrag, .shown = 0}}},
    {"after 12 frames any movement starts a drag",
     {{.action = kActionDown, .state = kTapping},
      {.addSteps = 11, .action = kActionMove, .state = kTapping, .step = 11},
      {.addSteps = 1, .action = kActionMove, .state = kDragging, .step = 12},
      {.action = kActionUp, .speed = kSlowDrag}}},
    {"a drag of nine frames returns to the tap, and the next drag counts from 0",
     {{.action = kActionDown, .state = kTapping},
      {.addSteps = 3, .x = 59, .action = kActionMove, .state = kDragging, .step = 3},
      {.addSteps = 9, .x = 59, .action = kActionUp, .state = kTapping, .step = 3, .dragStep = 9, .speed = kSlowDrag},
      {.action = kActionMove, .state = kDragging, .step = 3, .speed = kSlowDrag}}},
    {"a drag of ten frames ends",
     {{.action = kActionDown, .state = kTapping},
      {.addSteps = 3, .x = 59, .action = kActionMove, .state = kDragging, .step = 3},
      {.addSteps = 10, .x = 59, .action = kActionUp, .speed = kSlowDrag}}},
};

}  // namespace

TEST(Gesture, followsItsTransitionTable) {
    for (const Gesture& gesture : kGestures) {
        resetGestures();
        for (const Row& row : gesture.rows) {
            SCOPED_TRACE(testing::Message() << gesture.name << ", event " << &row - gesture.rows.data());
            (state == kDragging ? drag_step : step) += row.addSteps;
            touch(row.x, row.y, row.action, 0.5f);
            EXPECT_EQ(state, row.state);
            EXPECT_EQ(step, row.step);
            EXPECT_EQ(drag_step, row.dragStep);
            EXPECT_EQ(isMovingEvent, row.speed);
            EXPECT_EQ(fluid.ClearInkValue, row.shown);
            EXPECT_EQ(TOUCH_ACTION, row.action);
            EXPECT_EQ(PREV_POSITION_X, row.x);
            EXPECT_EQ(PREV_POSITION_Y, row.y);
            EXPECT_EQ(POSITION_Y, row.y);
        }
    }
}

TEST(Gesture, endOfADragLetsTheInkFade) {
    resetGestures();
    state = kDragging;
    drag_step = 10;
    fluid.SourceStrength = 45.0f;
    touch(59, 50, kActionUp, 1.0f);
    EXPECT_EQ(
        (std::array{fluid.SourceStrength, fluid.VelocityDissipation, fluid.DensityDissipation}),
        (std::array{0.0f, 0.9f, 0.9f}));
}

TEST(Gesture, measuresMovementOnlyDuringAGesture) {
    using Values = std::array<int, 7>;
    const auto after = [](int x, int y, int action) {
        touch(x, y, action, 1.0f);
        return Values{DX, DY, DRAG_START_X, DRAG_START_Y, DRAG_END_X, DRAG_END_Y, count};
    };
    resetGestures();
    count = 7;
    EXPECT_EQ(after(50, 60, kActionDown), (Values{0, 0, 50, 60, 50, 60, 0})) << "a touch-down is no movement";
    count = 7;
    EXPECT_EQ(after(57, 40, kActionMove), (Values{7, -20, 50, 60, 50, 60, 7})) << "only a frame moves the segment";
    EXPECT_EQ(after(58, 42, kActionCancel), (Values{1, 2, 50, 60, 50, 60, 7}));
    EXPECT_EQ(after(9, 9, kActionMove), (Values{1, 2, 50, 60, 50, 60, 7})) << "without a gesture";
    EXPECT_EQ(after(20, 30, kActionDown), (Values{1, 2, 20, 30, 20, 30, 0}));
    EXPECT_EQ(after(25, 35, kActionDown), (Values{1, 2, 25, 35, 25, 35, 0})) << "a second touch-down restarts the tap";
    EXPECT_EQ(after(60, 9, kActionCancel), (Values{1, 2, 25, 35, 25, 35, 0})) << "a cancelled tap";
}

TEST(Gesture, weighsPressureAndAcceptsAnyValue) {
    const float inf = std::numeric_limits<float>::infinity();
    const auto weightOf = [](float pressure) {
        resetGestures();
        touch(1, 1, kActionDown, pressure);
        return TouchPressure;
    };
    EXPECT_FLOAT_EQ(weightOf(1.0f), 1.2f);
    // The sum is computed in double precision from 0.2f; a double 0.2 would give other results for these two.
    EXPECT_EQ(weightOf(0.1f), static_cast<float>(double{0.1f} * double{0.1f} + double{0.2f}));
    EXPECT_EQ(weightOf(0.0001f), std::nextafter(0.2f, 1.0f));
    for (const float none : {0.0f, -1.0f, -inf, std::nanf("")}) EXPECT_EQ(weightOf(none), 0.0f);
    EXPECT_EQ(weightOf(inf), inf);
    for (const int far : {std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        touch(far, -1, kActionDown, 1.0f);
        touch(-1, far, kActionMove, 1.0f);
        touch(far, far, kActionUp, 1.0f);
    }
}
