#include "host/water_host.h"
#include "host/picture.h"

#include <algorithm>
#include <limits>
#include <numeric>

#include "probes/gesture_state.h"
#include "probes/smooth_picture.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

class Host : public GlTest {
protected:
    static constexpr int kLong = 96;
    static constexpr int kShort = 54;

    WaterHost start(int width, int height, bool withInk = false, const Look& look = {}) {
        renewContext(width, height);
        resetGestures();
        srand48(1);
        WaterHost host(look, width, height, 1);
        host.setUp(withInk);
        host.loadPictures(sourceOf(pictures));
        return host;
    }

    // The pictures are much higher and wider than the view, so that cropping is visible.
    const Pictures pictures = {smoothPicture(120, 300, 1), smoothPicture(300, 120, 2), smoothPicture(16, 16, 3)};
};

void expectMiddleOf(const std::vector<Rgba>& pixels, int width, int height, const Picture& picture) {
    const double scale = std::max(double{1} * width / picture.width, double{1} * height / picture.height);
    for (int y = 0; y < height; y += 5) {
        for (int x = 0; x < width; x += 5) {
            const int column = static_cast<int>(picture.width / 2.0 + (x + 0.5 - width / 2.0) / scale);
            const int row = static_cast<int>(picture.height / 2.0 - (y + 0.5 - height / 2.0) / scale);
            for (std::size_t c = 0; c < 3; ++c) {
                const int expected = picture.rgba[static_cast<std::size_t>((row * picture.width + column) * 4) + c];
                ASSERT_NEAR(pixels[static_cast<std::size_t>(y * width + x)][c], expected, 3) << x << ", " << y;
            }
        }
    }
}

}  // namespace

TEST_F(Host, aFlatSurfaceShowsThePhotoUndistortedAndFillingTheView) {
    start(kShort, kLong).draw();
    expectMiddleOf(readPixels(kShort, kLong), kShort, kLong, pictures.portrait);
    WaterHost host = start(kLong, kShort);
    host.draw();
    expectMiddleOf(readPixels(kLong, kShort), kLong, kShort, pictures.landscape);

    // Turning the view keeps the transferred pictures.
    renewContext(kShort, kLong);
    host.resize(kShort, kLong);
    host.setUp(false);
    host.loadPictures(sourceOf(pictures), 0);
    host.draw();
    expectMiddleOf(readPixels(kShort, kLong), kShort, kLong, pictures.portrait);
}

TEST_F(Host, ringsAreRoundOnTheScreen) {
    WaterHost host = start(kShort, kLong);
    ASSERT_TRUE(host.advance(0.0)) << "the first frame is always drawn";
    host.draw();
    const auto flat = readPixels(kShort, kLong);
    EXPECT_FALSE(host.advance(1.0 / 60)) << "calm water asks for no frame";

    host.touch(TouchAction::down, kShort / 2, kLong / 2, 1.0f);
    ASSERT_TRUE(host.advance(8.0 / 60));
    host.draw();
    const auto ring = readPixels(kShort, kLong);
    int left = kShort;
    int right = 0;
    int bottom = kLong;
    int top = 0;
    for (int y = 0; y < kLong; ++y) {
        for (int x = 0; x < kShort; ++x) {
            const auto i = static_cast<std::size_t>(y * kShort + x);
            if (std::abs(ring[i][0] - flat[i][0]) + std::abs(ring[i][1] - flat[i][1]) < 12) continue;
            left = std::min(left, x);
            right = std::max(right, x);
            bottom = std::min(bottom, y);
            top = std::max(top, y);
        }
    }
    EXPECT_GT(right - left, 5);
    EXPECT_NEAR(right - left, top - bottom, 3);
    EXPECT_NEAR((left + right) / 2, kShort / 2, 2);
    EXPECT_NEAR((bottom + top) / 2, kLong / 2, 2);
}

TEST_F(Host, ringsRunAtTheirSpeed) {
    for (const float speed : {0.1f, 0.2713f, 1.0f, 2.0f}) {
        WaterHost host = start(kShort, kLong, false, {.ringSpeed = speed, .calmingTime = 100.0f, .rebound = 0.0f});
        host.splash(kShort / 2, kLong / 2, 1.0f);
        // Measured from the middle of the steps that raise the drop.
        const double time = 0.4 / speed + 4.0 / host.lattice().stepsPerSecond;
        for (int i = 0; i < 240; ++i) host.advance(time / 240);
        const int n = host.lattice().points;
        const auto column = host.heights().begin() + n / 2 * n + n / 2;
        const auto crest = std::max_element(column, column + n / 2) - column;
        EXPECT_NEAR(static_cast<double>(crest) * Look{}.pictureZoom / (n - 1), 0.4, 0.02) << speed << " view heights";
    }
}

TEST_F(Host, theFrameRateDoesNotChangeTheWater) {
    const auto after = [this](double frame, int frames) {
        WaterHost host = start(kShort, kLong);
        host.touch(TouchAction::down, 20, 30, 1.0f);
        for (int i = 0; i < frames; ++i) host.advance(frame);
        host.draw();
        return readPixels(kShort, kLong);
    };
    EXPECT_EQ(after(1.0 / 60, 24), after(1.0 / 30, 12));
    EXPECT_EQ(after(1.0 / 60, 24), after(1.0 / 120, 48));
    EXPECT_EQ(after(60.0, 1), after(0.25, 1)) << "a pause is cut to the longest frame";
}

// There are no ripples, so only the ink requests frames and changes the picture.
TEST_F(Host, inkBloomsInItsColorFadesAndIsClearedAtOnce) {
    constexpr int width = 150;
    constexpr int height = 200;
    Look look;
    look.touchAmplitude = 0.0f;
    look.breeze = 0.0f;
    look.inkRed = 0.05f;
    look.inkGreen = 0.15f;
    look.inkBlue = 0.45f;
    look.stepsToRest = 1;
    look.meshVertices = 16;
    WaterHost host = start(width, height, true, look);
    host.draw();
    const auto clear = readPixels(width, height);
    const auto at = [](int x, int y) { return static_cast<std::size_t>(y * width + x); };
    const auto tap = [&host] {
        host.touch(TouchAction::down, width / 2, height / 2, 1.0f);
        host.touch(TouchAction::up, width / 2, height / 2, 1.0f);
    };
    tap();
    for (int i = 0; i < 8; ++i) {
        host.advance(1.0 / 60);
        host.draw();
    }
    const auto inked = readPixels(width, height);
    std::array<int, 3> dark;
    for (std::size_t c = 0; c < 3; ++c)
        dark[c] = clear[at(width / 2, height / 2)][c] - inked[at(width / 2, height / 2)][c];
    EXPECT_GT(dark[0], dark[1] + 5) << "blue ink takes most of the red";
    EXPECT_GT(dark[1], dark[2] + 5);
    EXPECT_GT(dark[2], 0);
    EXPECT_EQ(inked[at(5, 5)], clear[at(5, 5)]) << "the blot has not come that far";

    host.clearInk();
    host.draw();
    EXPECT_EQ(readPixels(width, height), clear);

    tap();
    int frames = 0;
    for (; host.advance(1.0 / 60) && frames < 400; ++frames) host.draw();
    EXPECT_NEAR(frames, look.framesToFade, 2) << "and one or two until the finger has gone";
    const auto faded = readPixels(width, height);
    for (std::size_t i = 0; i < clear.size(); ++i) ASSERT_NEAR(faded[i][0], clear[i][0], 2);

    host.touch(TouchAction::down, 60, 60, 1.0f);
    for (int i = 1; i < 5; ++i) host.touch(TouchAction::move, 60 + 8 * i, 60, 1.0f);
    for (const bool withInk : {false, true}) host.setUp(withInk);
    host.touch(TouchAction::move, 80, 120, 1.0f);
    host.draw();
    host.draw();
    EXPECT_EQ(readPixels(width, height), clear) << "a switch ends the stroke that it interrupts";
}

TEST_F(Host, aMoveFollowsAFingerAndRaisesAShortTrailAtMost) {
    WaterHost host = start(kShort, kLong, true, {.longestTrail = 3.0f, .trailShare = 0.5f, .rebound = 0.0f});
    const auto raised = [&host] { return std::accumulate(host.heights().begin(), host.heights().end(), 0.0); };
    host.draw();
    const auto clear = readPixels(kShort, kLong);
    for (int i = 0; i < 5; ++i) host.touch(TouchAction::move, 20, 20 + 10 * i, 1.0f);
    EXPECT_EQ(raised(), 0.0) << "no finger is down";
    for (int i = 0; i < 400 && !host.isResting(); ++i) {
        if (host.advance(1.0 / 60)) host.draw();
    }
    EXPECT_TRUE(host.isResting());
    EXPECT_EQ(readPixels(kShort, kLong), clear);

    const auto swelled = [&] {  // the sum of the heights is constant once a drop is complete
        for (int i = 0; i < 9; ++i) host.advance(1.0 / 60);
        return raised();
    };
    host.touch(TouchAction::down, 20, 20, 1.0f);
    const double one = swelled();
    host.touch(TouchAction::move, 20, 70, 1.0f);
    EXPECT_NEAR(swelled(), (1 + 3 * 0.5) * one, 0.2 * one);
}

TEST_F(Host, numbersBeyondAllMeasureLeaveTheWaterAlive) {
    constexpr float kInfinity = std::numeric_limits<float>::infinity();
    constexpr float kNan = std::numeric_limits<float>::quiet_NaN();
    WaterHost host = start(kShort, kLong, false, {.calmingTime = 1.0f});
    const auto highest = [&host](int frames) {
        for (int i = 0; i < frames; ++i) host.advance(1.0 / 60);
        const auto [low, high] = std::minmax_element(host.heights().begin(), host.heights().end());
        return std::max(-*low, *high);
    };
    for (const float weight : {kNan, kInfinity, -kInfinity}) host.splash(20, 30, weight);
    host.splash(kNan, 30, 1.0f);
    host.touch(TouchAction::down, kInfinity, 30, 1.0f);
    EXPECT_EQ(highest(9), 0.0f);
    host.touch(TouchAction::down, 20, 30, kNan);
    const float lightest = highest(6);
    EXPECT_GT(lightest, 0.1f) << "a touch without a weight counts as the lightest";
    highest(600);
    host.touch(TouchAction::down, 20, 30, 1.0e38f);
    host.touch(TouchAction::move, -1.0e300, 1.0e300, 1.0e38f);
    host.touch(TouchAction::up, 1.0e300, 0.0, kNan);
    EXPECT_LT(highest(6), 6.0f * lightest) << "and the heaviest five times as much";
    host.splash(20, 30, 1.0e38f);
    EXPECT_GT(highest(6), 10.0f);
    EXPECT_LT(highest(1000), 0.5f);
    host.splash(20, 30, 1.0f);
    EXPECT_GT(highest(6), 1.0f);
}

// A step function, with different colours at the left and right edge, which must not be smeared.
TEST_F(Host, thePictureReachesEveryEdgeAtAnySize) {
    for (const auto& [width, height] :
         {std::pair{390, 844},
          {360, 640},
          {360, 800},
          {393, 852},
          {412, 915},
          {430, 932},
          {768, 1024},
          {810, 1080},
          {1024, 768},
          {1366, 768},
          {300, 300}}) {
        SCOPED_TRACE(testing::Message() << width << " x " << height);
        Picture ruler = {width, height, {}};
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                const auto tick = [](int place) { return static_cast<std::uint8_t>(place / 4 % 2 ? 200 : 50); };
                ruler.rgba.insert(ruler.rgba.end(), {tick(x), tick(y), 0, 255});
            }
        }
        renewContext(width, height);
        resetGestures();
        const Pictures rulers = {ruler, ruler, smoothPicture(16, 16, 3)};
        WaterHost host({.meshVertices = 32}, width, height, 1);
        host.setUp(false);
        host.loadPictures(sourceOf(rulers));
        host.draw();
        const auto pixels = readPixels(width, height);
        // The ticks at the edges alternate as often as in the middle.
        const auto changes = [&](std::size_t channel, int from, int next) {
            int result = 0;
            for (int i = 1; i < 13; ++i) {
                const auto at = [&](int k) { return pixels[static_cast<std::size_t>(from + k * next)][channel] > 125; };
                result += at(i) != at(i - 1);
            }
            return result;
        };
        const int middle = height / 2 * width;
        EXPECT_GE(changes(0, middle, 1), 2);
        EXPECT_GE(changes(0, middle + width - 1, -1), 2);
        EXPECT_GE(changes(1, width / 2, width), 2);
        EXPECT_GE(changes(1, (height - 1) * width + width / 2, -width), 2);
    }
}

TEST(Fitted, keepsTheMiddleAndTheMeanOfWhatItScalesDown) {
    Picture fine = {600, 1000, {}};
    for (int i = 0; i < 600 * 1000; ++i) {
        const auto level =
            static_cast<std::uint8_t>((i % 600 + i / 600) % 2 ? 255 : 1);  // aliases unless it is averaged
        fine.rgba.insert(fine.rgba.end(), {level, static_cast<std::uint8_t>(i / 600 / 4), 7, 255});
    }
    const Picture small = fitted(fine, 91, 90);
    EXPECT_EQ(std::pair(small.width, small.height), std::pair(91, 90));
    for (int i = 0; i < 91 * 90; ++i) {
        const std::uint8_t* const pixel = &small.rgba[static_cast<std::size_t>(4 * i)];
        ASSERT_NEAR(pixel[0], 128, 12);
        // A width of 600 pixels for 91 requires the middle 593 rows for 90.
        ASSERT_NEAR(pixel[1], (500 + (i / 91 + 0.5 - 45) * 600 / 91) / 4, 1.0);
        ASSERT_EQ(std::pair(pixel[2], pixel[3]), std::pair(std::uint8_t{7}, std::uint8_t{255}));
    }
    const Picture crop = fitted(fine, 6000, 2000);
    EXPECT_EQ(std::pair(crop.width, crop.height), std::pair(600, 200));
    EXPECT_TRUE(std::equal(crop.rgba.begin(), crop.rgba.end(), fine.rgba.begin() + 4 * 600 * 400)) << "as they are";
    const Picture tall = fitted(fine, 996, 6000);
    EXPECT_EQ(std::pair(tall.width, tall.height), std::pair(166, 1000));
    EXPECT_TRUE(std::equal(tall.rgba.begin(), tall.rgba.begin() + 4 * 166, fine.rgba.begin() + 4 * 217));
}
