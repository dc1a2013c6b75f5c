// Every GL call of a frame, counted by name: a call too many is paid in every frame on a phone.
#include <gtest/gtest.h>

#include "fluid/fluid.h"
#include "host/water_host.h"
#include "jni/globals.h"
#include "tests/support/counting_gl.h"
#include "tests/support/gesture_state.h"
#include "tests/support/library_blocks.h"
#include "tests/support/log_recorder.h"
#include "tests/support/test_pictures.h"

namespace {

using Calls = std::map<std::string, int>;

Calls operator+(Calls a, const Calls& b) {
    for (const auto& [name, count] : b) a[name] += count;
    return a;
}

// The water: its uniforms by name, three arrays anew, two attributes, two textures.
const Calls kWater = {
    {"glViewport", 2},
    {"glUseProgram", 1},
    {"glGetUniformLocation", 14},
    {"glUniform1f", 11},
    {"glUniform1i", 2},
    {"glUniformMatrix4fv", 1},
    {"glGetAttribLocation", 2},
    {"glBindBuffer", 10},
    {"glBufferData", 3},
    {"glVertexAttribPointer", 2},
    {"glEnableVertexAttribArray", 2},
    {"glDisableVertexAttribArray", 2},
    {"glActiveTexture", 2 + 4},
    {"glBindTexture", 2 + 4},
    {"glDrawElements", 1}};

// Its ink: scale, colour, intensity and the density texture.
const Calls kShownInk = {{"glGetUniformLocation", 4}, {"glUniform1f", 1},     {"glUniform1i", 1},  {"glUniform2f", 1},
                         {"glUniform3f", 1},          {"glActiveTexture", 1}, {"glBindTexture", 1}};

// A pass over the ink draws the quad and puts everything back.
const Calls kPass = {
    {"glUseProgram", 1},
    {"glBindFramebuffer", 2},
    {"glBindBuffer", 1},
    {"glBufferData", 1},
    {"glEnableVertexAttribArray", 2},
    {"glVertexAttribPointer", 2},
    {"glDrawArrays", 1},
    {"glDisableVertexAttribArray", 1},
    {"glActiveTexture", 4},
    {"glBindTexture", 4},
    {"glDisable", 1}};

const Calls kMovedInk =
    kPass + Calls{{"glBindTexture", 1 + 2}, {"glTexImage2D", 1}, {"glViewport", 1},  {"glGetUniformLocation", 7},
                  {"glUniform1f", 2},       {"glUniform1i", 2},  {"glUniform2f", 3}, {"glActiveTexture", 2}};

const Calls kAddedInk =
    kPass + Calls{{"glViewport", 1},  {"glGetUniformLocation", 9}, {"glUniform1f", 3},  {"glUniform1i", 2},
                  {"glUniform2f", 4}, {"glActiveTexture", 1},      {"glBindTexture", 1}};

const Calls kInkFrame = kWater + kShownInk + kMovedInk;

class FrameCalls : public testing::Test {
protected:
    static constexpr int kWidth = 480;
    static constexpr int kHeight = 800;

    void start(bool withInk) {
        resetGestures();
        host.handOver({smoothPicture(8, 8, 1), smoothPicture(8, 8, 2), smoothPicture(8, 8, 3)});
        host.setUp(withInk);
        host.draw();
        takeGlUse();
    }

    GlUse frame() {
        host.draw();
        return takeGlUse();
    }

    LogRecorder log;
    const Look look = {};
    WaterHost host = WaterHost(look, kWidth, kHeight, 1);
};

}  // namespace

TEST_F(FrameCalls, waterAlone) {
    start(false);
    const GlUse use = frame();
    EXPECT_EQ(use.calls, kWater);
    const auto vertices = static_cast<std::size_t>(look.meshVertices * look.meshVertices);
    const auto indices = static_cast<std::size_t>(6 * (look.meshVertices - 1) * (look.meshVertices - 1));
    EXPECT_EQ(use.bytes, 2 * vertices * 3 * sizeof(float) + indices * sizeof(short));
}

TEST_F(FrameCalls, ripplesAndStepsCallNothing) {
    start(true);
    host.touch(TouchAction::down, 100, 100, 1.0f);
    host.rain(true);
    host.advance(0.1);
    EXPECT_EQ(takeGlUse().calls, Calls());
}

TEST_F(FrameCalls, idleInkIsMovedAndShown) {
    start(false);
    const std::size_t water = frame().bytes;
    start(true);
    const GlUse use = frame();
    EXPECT_EQ(use.calls, kInkFrame);
    const std::size_t grid = (kWidth / 12) * (kHeight / 12) * 4;
    const std::size_t quad = 4 * 4 * sizeof(short);
    EXPECT_EQ(use.bytes, water + grid + quad);
}

TEST_F(FrameCalls, aTapAddsOneInjectionInItsFirstTenFrames) {
    start(true);
    host.touch(TouchAction::down, kWidth / 2, kHeight / 2, 1.0f);
    for (int i = 0; i < 15; ++i) EXPECT_EQ(frame().calls, i < 10 ? kInkFrame + kAddedInk : kInkFrame) << i;
}

TEST_F(FrameCalls, aTapAtTheEdgeAddsNothing) {
    start(true);
    host.touch(TouchAction::down, 3, kHeight / 2, 1.0f);
    for (int i = 0; i < 15; ++i) EXPECT_EQ(frame().calls, kInkFrame) << i;
}

TEST_F(FrameCalls, aFastDragPushesTheFlowWithoutTheGpuAndAllocatesNothing) {
    start(true);
    host.touch(TouchAction::down, 100, 400, 1.0f);
    host.touch(TouchAction::move, 130, 400, 1.0f);
    for (int i = 1; i <= 6; ++i) {
        host.touch(TouchAction::move, 130 + 30 * i, 400, 1.0f);
        host.advance(1.0 / 60);
        const int before = LibraryBlocks::requested;
        host.draw();
        EXPECT_EQ(LibraryBlocks::requested, before);
        EXPECT_EQ(takeGlUse().calls, kInkFrame + kAddedInk) << i;
        ASSERT_EQ(fluid.DragMode, 2);
    }
}
