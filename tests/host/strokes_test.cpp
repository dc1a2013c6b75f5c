// The same stroke from different digitizers on different displays.
#include <algorithm>
#include <cmath>

#include "fluid/ink_tuning.h"
#include "host/live_water.h"
#include "host/picture.h"
#include "jni/globals.h"
#include "probes/gesture_state.h"
#include "probes/smooth_picture.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

constexpr int kWidth = 540;
constexpr int kHeight = 960;
constexpr double kLength = 1.2;  // duration of the stroke in seconds

struct Point {
    double x, y;
};

// The stroke accelerates along a curve and slows down at its end.
Point finger(double time) {
    const double t = std::clamp(time / kLength, 0.0, 1.0);
    const double along = t * t * (3 - 2 * t);
    return {110 + 320 * along, 480 + 250 * std::sin(5 * along)};
}

// The speed class for each ink step, or -2 if there is no drag.
std::vector<int> classes;

class Strokes : public GlTest {
protected:
    using Density = std::vector<float>;

    void SetUp() override {
        GlTest::SetUp();
        renewContext(kWidth, kHeight);
        watching.GetShortArrayElements = [](JNIEnv* env, jshortArray indices, jboolean* isCopy) {
            // Called once per ink step; recorded from the touch-down on.
            if (state != kIdle || !classes.empty()) classes.push_back(state == kDragging ? isMovingEvent : -2);
            return host->GetShortArrayElements(env, indices, isCopy);
        };
        hostEnvironment()->functions = &watching;
    }
    void TearDown() override {
        hostEnvironment()->functions = host;
        GlTest::TearDown();
    }

    // The digitizer reports `reports` times and the display draws `frames` times a second. With Android's resampling,
    // each frame receives the reports until 5 ms before it and an interpolated position for that time.
    Density draw(double reports, double frames, bool isResampled = false) {
        resetGestures();
        srand48(1);
        LiveWater water(sourceOf(pictures), 1, [] { return 0.0; });
        water.setLook({.meshVertices = 16, .touchAmplitude = 0.0f, .breeze = 0.0f});
        water.setView(kWidth, kHeight, 1.0, 0.0);
        water.setShortestFrame(1.0 / frames);  // so that no frame is late
        water.setInk(true);
        water.picturesChanged(kAllPictures);
        water.frame(0.0);
        water.resized();
        water.frame(0.0);
        classes.clear();
        const double start = 0.5;
        const auto send = [&](TouchAction action, double time, Point p) {
            water.touch(
                action, static_cast<float>(p.x / kWidth), static_cast<float>(p.y / kHeight), 1.0f, start + time);
        };
        int reported = 0;
        bool isDown = false, isUp = false;
        for (int i = 0; i / frames < start + kLength + 0.07; ++i) {
            const double now = i / frames;
            const double since = now - start;
            if (since >= 0 && !isDown) {
                send(TouchAction::down, 0, finger(0));
                isDown = true;
            }
            const double until = std::min(since - (isResampled ? 0.005 : 0.0), kLength);
            for (; isDown && (reported + 1) / reports <= until; ++reported) {
                send(TouchAction::move, (reported + 1) / reports, finger((reported + 1) / reports));
            }
            if (isResampled && isDown && until > 0 && until < kLength) send(TouchAction::move, until, finger(until));
            if (since >= kLength && !isUp) {
                send(TouchAction::up, kLength, finger(kLength));
                isUp = true;
            }
            water.frame(now);
        }
        return density();
    }

    static Density density() {
        glBindFramebuffer(GL_FRAMEBUFFER, fluid.Density.Ping.FboHandle);
        Density values;
        for (const Rgba& texel : readPixels(fluid.InkWidth, fluid.InkHeight)) {
            values.push_back(static_cast<float>(texel[0]) + static_cast<float>(texel[1]) / 255.0f);
        }
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return values;
    }

    static inline const JNINativeInterface_* const host = hostEnvironment()->functions;
    JNINativeInterface_ watching = *host;
    const Pictures pictures = {smoothPicture(8, 8, 1), smoothPicture(8, 8, 2), smoothPicture(8, 8, 3)};
};

}  // namespace

TEST_F(Strokes, areTheSameFromEveryDigitizerOnEveryDisplay) {
    const Density expected = draw(1000, 60);
    const std::vector<int> expectedClasses = classes;
    for (const int speed : {kSlowDrag, kMediumDrag, kFastDrag}) {
        EXPECT_GE(std::ranges::count(classes, speed), 3) << "the stroke has all speeds";
    }
    // A stroke that starts between two ink steps may have one more step.
    const auto sameClasses = [&](int lag) {
        int same = 0;
        for (int i = std::max(lag, 0); i < std::ssize(classes) && i - lag < std::ssize(expectedClasses); ++i) {
            same += classes[static_cast<std::size_t>(i)] == expectedClasses[static_cast<std::size_t>(i - lag)];
        }
        return same;
    };
    const auto expectSame = [&](const Density& actual, const std::string& what) {
        EXPECT_GE(
            std::max({sameClasses(-1), sameClasses(0), sameClasses(1)}),
            0.95 * static_cast<double>(expectedClasses.size()))
            << what;
        EXPECT_NEAR(static_cast<double>(classes.size()), static_cast<double>(expectedClasses.size()), 4) << what;
        double difference = 0;
        for (std::size_t i = 0; i < actual.size(); ++i) difference += std::fabs(actual[i] - expected[i]);
        EXPECT_LT(difference / static_cast<double>(actual.size()), 2.0) << what << ", of 255";
    };
    for (const auto& [reports, frames, isResampled] :
         {std::tuple(60, 60, false),
          {1000, 15, false},
          {119, 30, false},
          {237, 90, false},
          {60, 120, false},
          {119, 144, false},
          {119, 60, true}}) {
        const std::string what = std::to_string(reports) + (isResampled ? " resampled" : "") + " reports, " +
                                 std::to_string(frames) + " frames a second";
        expectSame(draw(reports, frames, isResampled), what);
    }
}

TEST_F(Strokes, tapsAreNeverLostAndAFingerAtRestDrawsNoLine) {
    StrokeClock clock;
    const auto actions = [&clock](double time) {
        std::string letters;
        for (const Touch& touch : clock.step(time)) letters += "duMc"[static_cast<int>(touch.action)];
        return letters;
    };
    clock.report({TouchAction::down, 10, 10, 1, 1.001});
    clock.report({TouchAction::up, 10, 10, 1, 1.002});
    clock.report({TouchAction::down, 50, 10, 1, 1.003});
    EXPECT_EQ(actions(1.0), "");
    EXPECT_EQ(actions(1.02), "dud") << "all in one step";
    EXPECT_EQ(actions(1.04), "") << "at rest";
    clock.report({TouchAction::move, 60, 10, 1, 1.1});
    EXPECT_EQ(actions(1.055), "") << "it has not set out yet";
    ASSERT_EQ(actions(1.08), "M");
    EXPECT_NEAR(clock.step(1.09)[0].x, 57.5f, 1e-3f) << "between two reports";
    EXPECT_EQ(clock.step(1.2)[0].x, 60.0f);
    EXPECT_EQ(actions(1.3), "") << "nothing is extrapolated";
    clock.report({TouchAction::move, 70, 10, 1, 1.21});
    EXPECT_EQ(actions(1.31), "M") << "a late report counts at the next step";
    clock.report({TouchAction::cancel, 70, 10, 1, 1.32});
    EXPECT_EQ(actions(1.4), "u") << "a cancel lifts the finger";
    clock.report({TouchAction::move, 90, 10, 1, 1.41});
    EXPECT_EQ(actions(1.5), "") << "no stroke without a finger";
    EXPECT_FALSE(clock.isActive());
}
