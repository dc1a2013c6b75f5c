// Simulates a day of touches without waiting between frames.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <iostream>
#include <random>
#include <span>
#include <tuple>

#include "jni/globals.h"
#include "probes/counting_gl.h"
#include "probes/gesture_state.h"
#include "probes/library_blocks.h"
#include "tests/endurance/strokes.h"
#include "tests/support/log_recorder.h"

using namespace tidemark;

namespace {

// While `looking`, checks the arrays that the library releases to the host.
bool looking = false;
bool finite = true;
const JNINativeInterface_* const host = hostEnvironment()->functions;

void lookAt(const float* values, std::size_t number) {
    finite = finite && std::all_of(values, values + number, [](float value) { return std::isfinite(value); });
}

class LongRun : public testing::Test {
protected:
    // View width, ink mode, calls and uploaded bytes of a frame.
    using Cost = std::tuple<int, bool, std::map<std::string, int>, std::size_t>;

    void SetUp() override {
        resetGestures();
        finite = true;
        hostEnvironment()->functions = &watching;
        watching.ReleaseFloatArrayElements = [](JNIEnv* env, jfloatArray reference, jfloat* elements, jint mode) {
            if (looking) lookAt(elements, static_cast<FloatArray*>(reference)->values.size());
            host->ReleaseFloatArrayElements(env, reference, elements, mode);
        };
        srand48(11);
        setUp(kAllPictures);
        // The first frame uses the larger view, so that the scratch buffers reach their final size.
        water.touch(TouchAction::down, 0, 0, 1.0f);
        water.advance(1.0 / 60);
        water.draw();
    }
    void TearDown() override { hostEnvironment()->functions = host; }

    unsigned below(unsigned end) { return static_cast<unsigned>(random() % end); }

    void setUp(unsigned duePictures = 0) {
        water.resize(width, 240);
        ::setUp(water, withInk, duePictures);
        log.take();
    }

    void frame() {
        looking = ++frames % 31 == 0;
        water.advance(1.0 / 60);
        takeGlUse();
        const int requests = LibraryBlocks::requested;
        water.draw();
        ASSERT_EQ(LibraryBlocks::requested, requests) << "frame " << frames << " allocates";
        const GlUse use = takeGlUse();
        if (costs) costs->emplace(width, withInk, use.calls, use.bytes);
        const Texture<vec2>& flow = fluid.VelocityTex;
        if (looking && withInk) lookAt(&flow.data->x, 2 * static_cast<std::size_t>(flow.width * flow.height));
        ASSERT_TRUE(finite) << "frame " << frames;
    }

    void rest(unsigned length) {
        while (length-- > 0 && !HasFailure()) frame();
    }

    // Plays a stroke or part of it with random pauses, then a random event: rain, clearing, a pause or a set-up.
    void play(const Stroke& stroke) {
        const auto events = below(2 * static_cast<unsigned>(stroke.size()));
        for (const StrokeEvent& event : std::span(stroke).first(std::min<std::size_t>(events, stroke.size()))) {
            water.touch(event.action, event.x * width, event.y * 240, 1.0f);
            rest(below(3));
        }
        rest(below(60));
        const unsigned event = below(15);
        if (event < 4) water.rain(event < 2);
        if (event == 5) water.clearInk();
        if (event == 6) {  // A pause of an hour; the next frame makes several ink steps.
            water.advance(3600.0);
            water.draw();
        }
        if (event == 7 || event == 8) withInk = !withInk;
        if (event == 9 || event == 10) width = 456 - width;
        if (event >= 7 && event < 12) setUp();
    }

    JNINativeInterface_ watching = *host;
    LogRecorder log;
    std::mt19937 random{3};
    int width = 252;  // or 204 for a portrait view
    bool withInk = true;
    WaterHost water{Look{.meshVertices = 16}, width, 240, 5};
    int frames = 0;
    std::set<Cost>* costs = nullptr;
};

}  // namespace

TEST_F(LongRun, memoryAndCostStayConstantAndValuesFinite) {
    const int hour = isFullLength() ? 216'000 : 5000;  // frames
    const std::vector<Stroke> strokes = strokesOfAllKinds();
    const int blocks = LibraryBlocks::live;
    std::set<Cost> atFirst;
    std::set<Cost> atLast;
    while (frames < 24 * hour && !HasFailure()) {
        costs = frames < hour ? &atFirst : frames >= 23 * hour ? &atLast : nullptr;
        play(strokes[below(static_cast<unsigned>(strokes.size()))]);
        EXPECT_EQ(LibraryBlocks::live, blocks);
    }
    EXPECT_EQ(atFirst.size(), 2U * 3) << "two views, each without ink, with advection, and with injection as well";
    EXPECT_TRUE(atFirst == atLast);
    std::cout << frames << " frames, " << blocks << " blocks\n";
}
