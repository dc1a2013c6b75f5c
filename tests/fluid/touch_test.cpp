#include "fluid/touch.h"

#include <gtest/gtest.h>

#include "tests/support/gesture_state.h"

TEST(Touch, marginsBelongToTheEdge) {
    Fluid engine;
    engine.ScreenWidth = 480;
    engine.ScreenHeight = 800;
    engine.BoundaryMargin = 60;
    EXPECT_FALSE(engine.isBoundary(61, 61));
    EXPECT_FALSE(engine.isBoundary(419, 739));
    for (const auto& [x, y] : {std::pair{60, 100}, {61, 60}, {420, 100}, {100, 740}, {-5, 100}, {100, 5000}}) {
        EXPECT_TRUE(engine.isBoundary(x, y)) << x << ", " << y;
    }
    engine.ScreenWidth = engine.ScreenHeight = 1;
    for (int p = -1; p < 3; ++p) EXPECT_TRUE(engine.isBoundary(p, p)) << "a tiny view is all margin";
}

TEST(Touch, strokesAreFlippedAndHaveADirectionIfTheyHaveALength) {
    Fluid engine;
    engine.ScreenHeight = 1920;
    recordStroke(engine, 100, 1000, 200, 1000);
    EXPECT_EQ(engine.Previous.x, 100.0f);
    EXPECT_EQ(engine.Previous.y, 920.0f);
    const Segment along = segmentBetween(engine.Previous, engine.Current);
    EXPECT_EQ(along.normal.x, 1.0f);
    EXPECT_EQ(along.normal.y, 0.0f);
    EXPECT_EQ(along.length, 100.0f);
    const Segment none = segmentBetween(engine.Current, engine.Current);
    EXPECT_EQ(none.normal.x, 0.0f);
    EXPECT_EQ(none.length, 1.0f);
}
