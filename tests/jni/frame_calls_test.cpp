// Counts the GL calls and uploaded bytes of a frame, because every frame on a phone pays for an extra one.
#include <gtest/gtest.h>

#include <array>

#include "fluid/ink_tuning.h"
#include "host/water_host.h"
#include "jni/gesture.h"
#include "jni/globals.h"
#include "probes/counting_gl.h"
#include "probes/gesture_state.h"
#include "probes/library_blocks.h"
#include "tests/support/frame.h"
#include "tests/support/log_recorder.h"

using namespace tidemark;

namespace {

constexpr int kMeshBytes = 2 * 12 * sizeof(float) + 6 * sizeof(short);
constexpr int kQuadBytes = 4 * 4 * sizeof(short);
constexpr int kGridBytes = (480 / 12) * (800 / 12) * 4;

struct Use {
    int calls, bytes;
};
constexpr Use kWater = {65, kMeshBytes};                                    // without ink
constexpr Use kAdvected = {116, kMeshBytes + kQuadBytes + kGridBytes};      // with ink advection
constexpr Use kInjected = {157, kMeshBytes + 2 * kQuadBytes + kGridBytes};  // with advection and injection

class FrameCalls : public testing::Test {
protected:
    void start(bool withInk, int width = 480) {
        resetGestures();
        Frame::setUp(width, 800, withInk);
        frame.draw();
        takeGlUse();
    }

    void expectFrame(const Use& expected) {
        const int before = LibraryBlocks::requested;
        frame.draw();
        EXPECT_EQ(LibraryBlocks::requested, before) << "a warm frame allocates nothing";
        const GlUse use = takeGlUse();
        int calls = 0;
        for (const auto& [name, times] : use.calls) calls += times;
        EXPECT_EQ(calls, expected.calls) << testing::PrintToString(use.calls);
        EXPECT_EQ(use.bytes, static_cast<std::size_t>(expected.bytes));
    }

    LogRecorder log;
    Frame frame;
};

}  // namespace

TEST_F(FrameCalls, matchTheTable) {
    start(false);
    expectFrame(kWater);
    start(true);
    expectFrame(kAdvected);
    touch(3, 400, kActionDown, 1.0f);
    for (int i = 0; i < 13; ++i) expectFrame(kAdvected);
    // A tap inside the margin injects ink in its first ten frames.
    touch(240, 400, kActionDown, 1.0f);
    for (int i = 0; i < 13; ++i) expectFrame(i < sim_step ? kInjected : kAdvected);
    // Perturb, which a fast drag calls, runs on the CPU only.
    touch(100, 400, kActionDown, 1.0f);
    for (int i = 1; i <= 6; ++i) {
        touch(100 + 30 * i, 400, kActionMove, 1.0f);
        expectFrame(kInjected);
    }
    EXPECT_EQ(fluid.DragMode, kFastDrag);
    // In a view narrower than a cell, the velocity texture has no texels and is still specified.
    start(true, 11);
    expectFrame({kAdvected.calls, kMeshBytes + kQuadBytes});
}

TEST_F(FrameCalls, deleteEqualNamesOfDifferentKinds) {
    GLuint shader = 7, program = 7, buffer = 7, stale = 7;
    const GlObject objects[] = {
        {kQuadBuffer, GlKind::shader, &shader},
        {kQuadBuffer, GlKind::program, &program},
        {kQuadBuffer, GlKind::buffer, &buffer},
        {kIndexBuffer, GlKind::buffer, &stale}};
    takeGlUse();
    deleteGroup(objects, kQuadBuffer);
    EXPECT_EQ(takeGlUse().calls, (std::map<std::string, int>{{"glDeleteShader", 1}, {"glDeleteProgram", 1}}))
        << "a buffer name that two members have is not deleted";
    EXPECT_EQ((std::array{shader, program, buffer, stale}), (std::array<GLuint, 4>{0, 0, 0, 7}));
}

TEST_F(FrameCalls, lateFrameDrawsTheWaterOnce) {
    WaterHost host(Look{}, 480, 800, 1);
    host.setUp(true);
    host.touch(TouchAction::down, 240, 400, 1.0f);
    const auto bytesOf = [&host](int steps) {
        host.advance(steps / 60.0);
        host.draw();
        return takeGlUse().bytes;
    };
    bytesOf(1);
    const std::size_t once = bytesOf(1);
    EXPECT_LE(bytesOf(4), once + 3 * (2 * kQuadBytes + kGridBytes));
}
