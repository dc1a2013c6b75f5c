#include "host/live_water.h"

#include <cmath>
#include <limits>

#include "host/look_fields.h"
#include "host/picture.h"
#include "jni/bitmaps.h"
#include "jni/globals.h"
#include "probes/gesture_state.h"
#include "probes/smooth_picture.h"
#include "tests/support/gl_test.h"

using namespace tidemark;

namespace {

using Frame = LiveWater::Frame;

class Live : public GlTest {
protected:
    static constexpr int kWidth = 72;
    static constexpr int kHeight = 128;

    void SetUp() override {
        GlTest::SetUp();
        renewContext(kWidth, kHeight);
        resetGestures();
        secondsAReading = 0.0;
        begin();
    }

    void begin(const Look& look = {}) {
        water = LiveWater(sourceOf(pictures), 1, [] { return clockSeconds += secondsAReading; });
        water.setLook(look);
        water.setView(kWidth, kHeight, 1.0, now);
        water.picturesChanged(kAllPictures);
    }

    // Draws the frame after `seconds`, and resizes the surface if the water requests it.
    Frame next(double seconds = 1.0 / 60) {
        Frame frame = water.frame(now += seconds);
        if (frame != Frame::resize) return frame;
        size = {water.width(), water.height()};
        water.resized();
        return water.frame(now);
    }

    void touch(TouchAction action = TouchAction::down) { water.touch(action, 0.4f, 0.3f, 1.0f, now); }

    int framesToRest() {
        int frames = 0;
        while (next() != Frame::resting && frames < 1000) ++frames;
        return frames;
    }

    std::vector<Rgba> seen() const { return readPixels(kWidth, kHeight); }

    // The calls that the next frame makes: P, L and W for transfers, | for a set-up, p, l and w for texture loads.
    std::string calls(double seconds = 1.0 / 60) {
        constexpr std::uint32_t kMark = 4711;
        AndroidBitmapInfo* const slots[] = {&bmp_portrait_bg_info, &bmp_landscape_bg_info, &bmp_water_Info};
        for (AndroidBitmapInfo* slot : slots) slot->flags = kMark;
        log.take();
        next(seconds);
        std::string calls;
        for (std::size_t i = 0; i < 3; ++i) {
            if (slots[i]->flags != kMark) calls += "PLW"[i];
        }
        for (const std::string& line : log.take()) {
            if (line == "I onInitSetting") calls += '|';
            if (line == "I onLoadPortraitBGTextures") calls += 'p';
            if (line == "I onLoadLandscapeBGTextures") calls += 'l';
            if (line.starts_with("I glDelete environment")) calls += 'w';
        }
        return calls;
    }

    const Pictures pictures = {smoothPicture(72, 128, 1), smoothPicture(128, 72, 2), smoothPicture(16, 16, 3)};
    // The clock that advances during a frame.
    static inline double clockSeconds, secondsAReading;
    LiveWater water{sourceOf(pictures), 1};
    Size size = {0, 0};
    double now = 100.0;
};

}  // namespace

TEST_F(Live, drawsWhatHasChangedAndRestsOtherwise) {
    begin({.meshVertices = 24});
    water.clearInk();
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_EQ(next(), Frame::resting);
    touch();
    EXPECT_LE(water.due(), now);
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_EQ(next(0.004), Frame::drawn) << "between two steps of the water";
    const int frames = framesToRest();
    EXPECT_GT(frames, 60);
    EXPECT_LT(frames, 600);

    touch(TouchAction::up);
    EXPECT_EQ(next(), Frame::resting) << "a finger that goes without ink changes nothing";
    water.redraw();
    EXPECT_EQ(next(), Frame::drawn);
    water.setRain(true);
    for (int i = 0; i < 600 && next() == Frame::waiting; ++i) continue;
    EXPECT_EQ(next(), Frame::drawn) << "no drop falls";
    water.setRain(false);
    EXPECT_LT(framesToRest(), 600);
}

TEST_F(Live, isSetUpBeforeThePicturesAreThere) {
    water = LiveWater(sourceOf(pictures), 1);
    water.setView(kWidth, kHeight, 1.0, now);
    water.picturesChanged(kPortraitPicture);
    water.splash(0.5f, 0.5f, 1.0f);
    EXPECT_EQ(calls(), "|");
    EXPECT_EQ(next(), Frame::resting);
    EXPECT_EQ(water.due(), std::numeric_limits<double>::infinity());
    water.picturesChanged(kLandscapePicture | kLightPicture);
    EXPECT_LE(water.due(), now);
    EXPECT_EQ(calls(), "PLWpl");
    EXPECT_EQ(next(), Frame::drawn) << "of the drop";
}

// While a divider is dragged, frames keep the old size.
TEST_F(Live, isSetUpOnceTheViewKeepsItsSizeAndHandsOverWhatIsOfOtherProportions) {
    EXPECT_EQ(calls(), "PLW|pl") << "at once for the first view";
    for (int i = 1; i < 30; ++i) {
        water.setView(kHeight, kWidth + i, 1.0, now);
        EXPECT_EQ(calls(1.0 / 30), "");
    }
    EXPECT_EQ(size, (Size{kWidth, kHeight}));
    water.setView(kHeight, kWidth, 1.0, now);
    EXPECT_EQ(calls(0.05), "");
    EXPECT_NEAR(water.due(), now + 0.05, 1e-6);
    EXPECT_EQ(calls(0.06), "|") << "the backgrounds fit the view that was turned";
    EXPECT_EQ(size, (Size{kHeight, kWidth}));
    water.setView(kHeight, kHeight, 1.0, now);
    EXPECT_EQ(calls(0.2), "PL|pl");
    water.setView(2 * kHeight, 2 * kHeight, 1.0, now);
    EXPECT_EQ(calls(0.2), "PL|pl") << "with the pixels of the larger view";
    water.picturesChanged(kLandscapePicture);
    EXPECT_EQ(calls(), "Ll");
    renewContext(kWidth, kHeight);
    water.renewContext();
    EXPECT_EQ(calls(), "|plw") << "the library has copies";
    water.setLook({.meshVertices = 64});
    EXPECT_EQ(calls(), "");
}

// Otherwise the screen would be empty until the next ink step.
TEST_F(Live, drawsASurfaceOfAnotherSizeAtOnceUnderAFinger) {
    water.setInk(true);
    next();
    touch();
    for (int i = 1; i < 200; ++i) {
        if (i % 41 == 0) water.setView(kWidth + i, kHeight, 1.0, now);
        const Size before = size;
        const Frame frame = next(1.0 / 240);
        EXPECT_TRUE(size == before || frame == Frame::drawn) << i;
    }
    EXPECT_EQ(size.width, kWidth + 164);
}

TEST_F(Live, aDropWithInkDoesNotEndTheStrokeOfAFinger) {
    water.setInk(true);
    next();
    touch();
    for (int i = 0; i < 9; ++i) {
        if (i == 3) water.splash(0.7f, 0.7f, 1.0f, true);
        touch(TouchAction::move);
        next();
        EXPECT_NEAR(POSITION_X, 0.4 * kWidth, 1) << i;
    }
}

TEST_F(Live, drawsAsManyPixelsAsTheQualityAllows) {
    for (const auto& [quality, density, pixels] :
         {std::tuple(Quality::low, 2.6, 1.0),
          {Quality::medium, 2.6, 2.0},
          {Quality::high, 2.6, 2.6},
          {Quality::high, 3.5, 3.0},
          {Quality::medium, 1.5, 1.5},
          {Quality::automatic, 3.5, 2.0}}) {
        EXPECT_EQ(
            drawnSize({360, 800, density}, quality, 1.0),
            (Size{static_cast<int>(360 * pixels), static_cast<int>(800 * pixels)}));
    }
    EXPECT_EQ(drawnSize({360, 800, 3.0}, Quality::automatic, 0.5), (Size{360, 800}));
    EXPECT_EQ(drawnSize({360, 800, 3.0}, Quality::medium, 0.5), (Size{720, 1600})) << "what is asked for stays";
    EXPECT_EQ(drawnSize({4000, 2000, 2.0}, Quality::high, 1.0), (Size{4096, 2048}));
    EXPECT_EQ(drawnSize({128, 96, 1.0}, Quality::automatic, 0.5), (Size{85, 64})) << "proportions of a small view";
    // A touch has the same relative position for any drawn size.
    for (const Quality quality : {Quality::low, Quality::medium}) {
        begin();
        water.setQuality(quality);
        water.setView(150, 200, 2.0, now);
        water.setInk(true);
        next();
        water.touch(TouchAction::down, 0.25f, 0.5f, 1.0f, now);
        for (int i = 0; i < 4; ++i) next();
        EXPECT_NEAR(4 * POSITION_X, size.width, 2);
        EXPECT_EQ(2 * POSITION_Y, size.height);
    }
}

// Only the breeze moves.
TEST_F(Live, aBreezeRisesWithATouchAndSinksToRestWithoutAJump) {
    begin({.meshVertices = 24, .touchAmplitude = 0.0f, .breeze = 2.0f});
    next();
    EXPECT_EQ(next(), Frame::resting);
    const auto flat = seen();
    const auto farthestFrom = [this](const std::vector<Rgba>& before) {
        int most = 0;
        const auto current = seen();
        for (std::size_t i = 0; i < current.size(); ++i) most = std::max(most, std::abs(current[i][0] - before[i][0]));
        return most;
    };
    touch();
    auto last = flat;
    int most = 0, jump = 0, frames = 0;
    for (; next() == Frame::drawn && frames < 1000; ++frames, last = seen()) {
        most = std::max(most, farthestFrom(flat));
        jump = std::max(jump, farthestFrom(last));
    }
    EXPECT_GT(most, 10);
    EXPECT_LT(jump, most / 2);
    EXPECT_LT(frames, 600);
    EXPECT_EQ(seen(), flat);

    water.setBreezeAlways(true);
    touch();
    for (int i = 0; i < 900; ++i) next();
    EXPECT_EQ(next(), Frame::drawn);
    water.setBreezeAlways(false);
    EXPECT_LT(framesToRest(), 600);
}

TEST(Shade, darkensAndCoolsABrightGroundOnly) {
    const Look look = {.wet = 1.0f};
    const Shade none = {1.0f, 1.0f, 1.0f};
    EXPECT_EQ(shadeOf(look, PictureSlot::portrait, 0.3f), none);
    EXPECT_EQ(shadeOf(look, PictureSlot::light, 1.0f), none);
    const Shade white = shadeOf(look, PictureSlot::portrait, 1.0f);
    EXPECT_LT(white.red, white.green);
    EXPECT_LT(white.green, white.blue);
    EXPECT_LT(white.blue, 0.7f);
}

TEST_F(Live, aPauseIsNotMadeUpFor) {
    enum Pause { kAfterTheLastFrame, kAfterRainWithoutADrop, kInTheWaves };
    const auto ringAfter = [this](Pause pause, double seconds) {
        begin({.rainDropsPerSecond = 0.0f});
        next();
        if (pause == kAfterRainWithoutADrop) {
            water.setRain(true);
            EXPECT_EQ(next(), Frame::waiting);
            water.setRain(false);
            EXPECT_EQ(next(), Frame::resting);
        }
        if (pause != kInTheWaves) now += seconds;
        touch();
        for (int i = 0; i < 12; ++i) next();
        next(pause == kInTheWaves ? 0.25 + seconds : 0.25);
        return seen();
    };
    for (const Pause pause : {kAfterTheLastFrame, kAfterRainWithoutADrop, kInTheWaves}) {
        EXPECT_TRUE(ringAfter(pause, 60.0) == ringAfter(pause, 0.0)) << pause;
    }
}

TEST_F(Live, aLookChangesOnWavingWaterUnlessAValueIsBeyondItsLimits) {
    next();
    const auto flat = seen();
    touch();
    for (int i = 0; i < 12; ++i) next();
    const auto ring = seen();
    for (const float bad : {0.0f, std::numeric_limits<float>::quiet_NaN(), std::numeric_limits<float>::infinity()}) {
        const LookField* const refused = water.setLook({.calmingTime = bad, .refractiveIndex = 1.2f});
        ASSERT_TRUE(refused);
        EXPECT_EQ(refused->name, "calmingTime");
    }
    EXPECT_EQ(next(0.0), Frame::drawn);
    EXPECT_EQ(seen(), ring) << "the water stays as it is";
    EXPECT_EQ(water.setLook({.refractiveIndex = 1.2f}), nullptr);
    EXPECT_EQ(next(0.0), Frame::drawn);
    EXPECT_NE(seen(), ring);
    EXPECT_NE(seen(), flat) << "the waves live on";
    water.setLook({.meshVertices = 64, .dropRadius = 0.05f});
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_NE(seen(), flat) << "on a coarser lattice too";
}

// `count` is the number of ink steps since the touch-down.
TEST_F(Live, inkMovesByTheClockOnAnyDisplay) {
    for (const double rate : {15.0, 30.0, 60.0, 75.0, 90.0, 120.0, 144.0}) {
        SCOPED_TRACE(rate);
        begin({.meshVertices = 24});
        next();
        water.setInk(true);
        next();
        touch();
        count = 0;
        const double start = now;
        int waited = 0;
        while (count < 72 && now < start + 9.0) {
            const bool isDue = water.due() <= now + 1.0 / rate;
            const Frame frame = next(1.0 / rate);
            EXPECT_EQ(frame == Frame::drawn, isDue) << now - start;
            waited += frame == Frame::waiting;
        }
        EXPECT_NEAR(now - start, 1.22, 1.0 / rate + 1.0 / 60) << "within a frame of the display and the ink";
        EXPECT_EQ(waited > 2, rate > 70) << "not before the next step is due";

        const int before = count;
        next(0.2);
        EXPECT_LE(count - before, 4) << "a late frame is not made up for without end";
        next();
        EXPECT_LE(count - before, 6) << "nor later";
    }
}

TEST_F(Live, stepsThatMakeUpForALateFrameTakeAQuarterOfItsTimeAtMost) {
    water.setInk(true);
    next();
    touch();
    next();
    for (const auto& [reading, steps] : {std::pair(0.001, 4), {0.004, 4}, {0.006, 3}, {0.01, 2}, {0.1, 1}}) {
        secondsAReading = reading;
        count = 0;
        for (int i = 0; i < 2; ++i) next(1.0 / 15);
        EXPECT_EQ(count, 2 * steps) << reading;
    }
    secondsAReading = 0.0;
    count = 0;
    next();
    EXPECT_EQ(count, 1) << "those left out are not taken later";
}

// A frame takes two refreshes of the display unless it has fewer pixels.
TEST_F(Live, drawsLessWhereTheDisplayIsKeptWaiting) {
    begin({});
    water.setView(480, 270, 1.0, now);
    water.setRain(true);
    const auto vertices = [] {
        GLint bytes = 0;
        glBindBuffer(GL_ARRAY_BUFFER, fluid.v_buf);
        glGetBufferParameteriv(GL_ARRAY_BUFFER, GL_BUFFER_SIZE, &bytes);
        return bytes / 12;
    };
    int best = 0;
    for (const double end = now + 3.5; now < end;) {
        water.picturesChanged(kLandscapePicture);  // a moving picture
        if (next(size.width > 400 ? 1.0 / 30 : 1.0 / 60) != Frame::drawn) continue;
        best = std::max(best, vertices());
    }
    EXPECT_LT(vertices(), best / 2);
    EXPECT_LE(size.width, 400);
    EXPECT_NEAR(size.width * 270.0 / size.height, 480, 3);
}
