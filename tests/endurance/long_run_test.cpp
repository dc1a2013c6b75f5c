// A day of hands on the water, as fast as it goes.
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <iostream>
#include <iterator>
#include <limits>
#include <map>
#include <random>
#include <tuple>

#include "fluid/fluid.h"
#include "host/water_host.h"
#include "jni/globals.h"
#include "tests/endurance/lengths.h"
#include "tests/support/counting_gl.h"
#include "tests/support/gesture_state.h"
#include "tests/support/library_blocks.h"
#include "tests/support/log_recorder.h"
#include "tests/support/test_pictures.h"

namespace {

constexpr int kSecond = 60;  // frames
constexpr int kMinute = 60 * kSecond;
constexpr int kHour = 60 * kMinute;

struct View {
    int width;
    int height;
};
constexpr View kViews[] = {{240, 204}, {168, 240}, {204, 156}};

bool isFinite(const float* values, std::size_t number) {
    return std::all_of(values, values + number, [](float value) { return std::isfinite(value); });
}

// Looks at the arrays that the library gives back to its host, while it is asked to.
class ArrayWatch {
public:
    ArrayWatch() : table_(*hostEnvironment()->functions) {
        original_ = hostEnvironment()->functions;
        table_.ReleaseFloatArrayElements = [](JNIEnv* env, jfloatArray reference, jfloat* elements, jint mode) {
            const auto& array = *static_cast<FloatArray*>(reference);
            if (looking) ++looks;
            if (looking && !isFinite(elements, array.values.size())) finite = false;
            original_->ReleaseFloatArrayElements(env, reference, elements, mode);
        };
        hostEnvironment()->functions = &table_;
    }
    ~ArrayWatch() { hostEnvironment()->functions = original_; }
    ArrayWatch(const ArrayWatch&) = delete;
    ArrayWatch& operator=(const ArrayWatch&) = delete;

    static inline bool looking = false;
    static inline bool finite = true;
    static inline int looks = 0;

private:
    static inline const JNINativeInterface_* original_ = nullptr;
    JNINativeInterface_ table_;
};

// Frames that must cost the same: with ink or not, with an injection or not, in one view.
using Kind = std::tuple<bool, bool, const View*>;
using Cost = std::pair<std::map<std::string, int>, std::size_t>;
using Costs = std::map<Kind, Cost>;

class LongRun : public testing::Test {
protected:
    static Look smallMesh() {
        Look look;
        look.meshVertices = 16;
        return look;
    }

    void SetUp() override {
        resetGestures();
        srand48(11);
        host.handOver({smoothPicture(8, 8, 1), smoothPicture(8, 8, 2), smoothPicture(8, 8, 3)});
    }

    int pick(int from, int to) { return from + static_cast<int>(random() % static_cast<unsigned>(to - from + 1)); }
    bool oneIn(int chances) { return pick(1, chances) == 1; }

    void setUp() {
        host.resize(view->width, view->height);
        host.setUp(withInk);
        ++setUps;
        // Anything that is read before it is written spreads from here.
        for (const Texture<float>& field : {fluid.PressureTex, fluid.PressureTexTemp, fluid.DivergenceTex}) {
            std::fill_n(
                field.data, field.data ? field.width * field.height : 0, std::numeric_limits<float>::quiet_NaN());
        }
        log.take();
        if (isWarm) {
            EXPECT_EQ(LibraryBlocks::live, blocks);
        }
        requests = LibraryBlocks::requested;
    }

    void touch(int action, int x, int y) {
        host.touch(static_cast<TouchAction>(action), x, y, 0.1f * static_cast<float>(pick(0, 15)));
    }

    void frame() {
        ArrayWatch::looking = frames % 31 == 0;
        host.advance(1.0 / 60);
        const bool injects = (state == 1 && step < sim_step) || state == 2;
        if (costs) takeGlUse();
        host.draw();
        ++frames;
        if (isWarm) {
            ASSERT_EQ(LibraryBlocks::requested, requests) << "frame " << frames << " allocates";
        }
        if (costs) {
            const GlUse use = takeGlUse();
            const Kind kind = {withInk, withInk && injects && !fluid.isBoundary(POSITION_X, POSITION_Y), view};
            const auto [at, isNew] = costs->try_emplace(kind, use.calls, use.bytes);
            ASSERT_EQ(at->second, Cost(use.calls, use.bytes)) << "frame " << frames;
        }
        if (ArrayWatch::looking) checkFields();
    }

    void checkFields() {
        ASSERT_TRUE(ArrayWatch::finite) << "water, frame " << frames;
        if (!withInk) return;
        const auto texels = static_cast<std::size_t>(fluid.GridWidth * fluid.GridHeight);
        for (const Texture<vec2>& field : {fluid.VelocityTex, fluid.VelocityTexTemp}) {
            ASSERT_TRUE(isFinite(&field.data->x, 2 * texels)) << "flow, frame " << frames;
        }
        std::ptrdiff_t unwritten = 0;
        for (const Texture<float>& field : {fluid.PressureTex, fluid.PressureTexTemp, fluid.DivergenceTex}) {
            unwritten += std::count_if(field.data, field.data + texels, [](float p) { return !std::isfinite(p); });
        }
        ASSERT_TRUE(unwritten == 0 || unwritten == static_cast<std::ptrdiff_t>(3 * texels)) << "frame " << frames;
    }

    void rest(int length) {
        for (int i = 0; i < length && !HasFailure(); ++i) frame();
    }

    // Its going down or up, as the platform codes them, with a place that may be anywhere.
    void secondFinger() {
        const int action = (oneIn(2) ? 5 : 6) | 1 << 8;
        const int x = pick(0, view->width);
        const int y = pick(0, view->height);
        touch(action, x, y);
    }

    // A finger goes down, moves by up to `fastest` pixels a frame and goes up, unless the platform takes it away.
    void stroke(int slowest, int fastest, int length) {
        int x = pick(-5, view->width + 5);
        int y = pick(-5, view->height + 5);
        touch(0, x, y);
        rest(pick(0, 2));
        const int way = pick(slowest, fastest);
        const int signX = oneIn(2) ? 1 : -1;
        const int signY = pick(-1, 1);
        for (int i = 0; i < length && !HasFailure(); ++i) {
            x += signX * way;
            y += signY * pick(0, way);
            touch(2, x, y);
            if (!oneIn(10)) frame();
            if (oneIn(100)) secondFinger();
        }
        touch(oneIn(15) ? 3 : 1, x, y);
    }

    void doSomething() {
        switch (pick(0, 5)) {
            case 0:
                return stroke(0, 0, pick(0, 3));
            case 1:
                return stroke(0, 2, pick(5, 40));
            case 2:
                return stroke(3, 9, pick(5, 40));
            case 3:
                return stroke(11, 40, pick(3, 20));
            case 4:
                return rest(pick(1, 90));
            default:
                break;
        }
        if (oneIn(8)) {
            host.rain(raining = !raining);
        } else if (oneIn(8)) {
            host.clearInk();
        } else if (oneIn(20)) {
            withInk = !withInk;
            setUp();
        } else if (oneIn(20)) {
            view = &kViews[pick(0, static_cast<int>(std::size(kViews)) - 1)];
            setUp();
        } else if (oneIn(20)) {
            setUp();  // the context was lost
        } else if (oneIn(40)) {
            stroke(0, 0, 5 * kSecond);
        } else if (oneIn(10)) {
            host.advance(3600.0);  // nobody looked for a while
        }
    }

    void until(int end) {
        while (frames < end && !HasFailure()) doSomething();
    }

    ArrayWatch watch;
    LogRecorder log;
    std::mt19937 random{3};
    const View* view = &kViews[0];
    WaterHost host{smallMesh(), kViews[0].width, kViews[0].height, 5};
    bool withInk = true;
    bool raining = false;
    int frames = 0;
    int setUps = 0;
    bool isWarm = false;
    int blocks = 0;    // of the library, once warm
    int requests = 0;  // for memory, until the latest set-up
    Costs* costs = nullptr;
};

}  // namespace

TEST_F(LongRun, aDayNeitherGrowsNorSlowsDownNorLeavesTheNumbers) {
    const int total = isFullLength() ? 24 * kHour : 20 * kMinute;
    const int window = isFullLength() ? kHour : 5 * kMinute;
    // The largest view comes first: the buffers that only grow are grown by then.
    setUp();
    touch(0, 0, 0);
    rest(1);
    blocks = LibraryBlocks::live;
    requests = LibraryBlocks::requested;
    isWarm = true;

    Costs atFirst;
    Costs atLast;
    costs = &atFirst;
    until(window);
    costs = nullptr;
    until(total - window);
    costs = &atLast;
    until(total);
    EXPECT_EQ(atFirst.size(), 3 * std::size(kViews)) << "every kind was seen";
    EXPECT_EQ(atFirst, atLast);
    EXPECT_GT(ArrayWatch::looks, total / 31);
    std::cout << frames << " frames, " << setUps << " set-ups, " << blocks << " blocks, " << ArrayWatch::looks
              << " arrays looked at\n";
}
