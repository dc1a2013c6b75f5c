#include "host/live_water.h"

#include "jni/bitmaps.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tests/support/test_pictures.h"

namespace {

using Frame = LiveWater::Frame;

class Live : public GlTest {
protected:
    static constexpr int kWidth = 54;
    static constexpr int kHeight = 96;

    void SetUp() override {
        GlTest::SetUp();
        renewContext(kWidth, kHeight);
        resetGestures();
        water.resize(kWidth, kHeight);
        water.setPictures(pictures(1));
    }

    static Pictures pictures(int variant) {
        return {smoothPicture(54, 96, variant), smoothPicture(96, 54, variant + 1), smoothPicture(16, 16, variant + 2)};
    }

    // The frame one sixtieth of a second later.
    Frame next() { return water.frame(now += 1.0 / 60); }

    int framesToRest() {
        int frames = 0;
        while (next() != Frame::resting && frames < 1000) ++frames;
        return frames;
    }

    std::vector<Rgba> seen() const { return readPixels(kWidth, kHeight); }

    // What the next frame tells the library: P, L and W for hand-overs, | for a set-up, p, l and w for texture loads.
    std::string told() {
        constexpr std::uint32_t kMark = 4711;
        AndroidBitmapInfo* const slots[] = {&bmp_portrait_bg_info, &bmp_landscape_bg_info, &bmp_water_Info};
        for (AndroidBitmapInfo* slot : slots) slot->flags = kMark;
        log.take();
        next();
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

    LiveWater water{Look{}, 1};
    double now = 100.0;
};

}  // namespace

TEST_F(Live, drawsWhatHasChangedAndRestsOtherwise) {
    LiveWater without(Look{}, 1);
    EXPECT_EQ(without.frame(0.0), Frame::resting) << "there is no picture yet";

    water.setLook({.meshVertices = 24});
    water.touch(TouchAction::down, 20, 30, 1.0f);
    water.clearInk();
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_EQ(next(), Frame::resting) << "a touch before there is water";
    water.touch(TouchAction::down, 20, 30, 1.0f);
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_EQ(water.frame(now + 0.004), Frame::drawn) << "between two steps of the water";
    EXPECT_EQ(next(), Frame::drawn);
    const int frames = framesToRest();
    EXPECT_GT(frames, 60);
    EXPECT_LT(frames, 600);

    water.redraw();
    EXPECT_EQ(next(), Frame::drawn);
    water.setRain(true);
    for (int i = 0; i < 600 && next() == Frame::waiting; ++i) continue;
    EXPECT_EQ(next(), Frame::drawn) << "no drop falls";
    water.setRain(false);
    EXPECT_LT(framesToRest(), 600);
}

TEST_F(Live, tellsTheLibraryOnlyWhatHasChanged) {
    next();
    water.setInk(true);
    EXPECT_EQ(told(), "|");
    water.resize(kHeight, kWidth);
    EXPECT_EQ(told(), "|") << "the backgrounds fit the view that was turned";
    water.resize(kHeight, kHeight);
    EXPECT_EQ(told(), "PL|pl");
    water.setPictures(pictures(1));
    EXPECT_EQ(told(), "");
    Pictures others = pictures(1);
    others.landscape = pictures(2).landscape;
    water.setPictures(others);
    EXPECT_EQ(told(), "Ll");
    renewContext(kWidth, kHeight);
    water.renewContext();
    EXPECT_EQ(told(), "|plw") << "the library has copies";
    Look look;
    look.meshVertices = 64;
    water.setLook(look);
    EXPECT_EQ(told(), "");
    look.meshExtent = 20;
    water.setLook(look);
    water.resize(kWidth, kHeight);
    water.setPictures(pictures(3));
    EXPECT_EQ(told(), "PLW|plw");
}

TEST_F(Live, aPauseIsNotMadeUpFor) {
    enum Pause { kAfterTheLastFrame, kAfterRainWithoutADrop, kInTheWaves };
    const auto ringAfter = [this](Pause pause, double seconds) {
        Look look;
        look.rainDropsPerSecond = 0.0f;
        water = LiveWater(look, 1);
        water.resize(kWidth, kHeight);
        water.setPictures(pictures(1));
        next();
        if (pause == kAfterRainWithoutADrop) {
            water.setRain(true);
            EXPECT_EQ(next(), Frame::waiting);
            water.setRain(false);
            EXPECT_EQ(next(), Frame::resting);
        }
        if (pause != kInTheWaves) now += seconds;
        water.touch(TouchAction::down, 20, 30, 1.0f);
        for (int i = 0; i < 3; ++i) next();
        if (pause == kInTheWaves) {
            water.resize(kWidth, kHeight);
            now += seconds;
        }
        for (int i = 0; i < 3; ++i) next();
        return seen();
    };
    for (const Pause pause : {kAfterTheLastFrame, kAfterRainWithoutADrop, kInTheWaves}) {
        EXPECT_TRUE(ringAfter(pause, 60.0) == ringAfter(pause, 0.0)) << pause;
    }
}

TEST_F(Live, aLookChangesOnWavingWater) {
    next();
    const auto flat = seen();
    water.touch(TouchAction::down, 20, 30, 1.0f);
    for (int i = 0; i < 6; ++i) next();
    const auto ring = seen();
    Look look;
    look.refractiveIndex = 1.2f;
    water.setLook(look);
    EXPECT_EQ(next(), Frame::drawn);
    const auto lessBent = seen();
    EXPECT_NE(lessBent, ring);
    EXPECT_NE(lessBent, flat) << "the waves live on";
    look.meshVertices = 64;
    look.dropRadius = 0.05f;
    water.setLook(look);
    EXPECT_EQ(next(), Frame::drawn);
    EXPECT_NE(seen(), flat) << "on a coarser lattice too";
}

// `count` counts the ink's steps since the finger came down.
TEST_F(Live, inkMovesByTheClockOnAnyDisplay) {
    water.setLook({.meshVertices = 24});
    for (const double rate : {30.0, 60.0, 75.0, 90.0, 120.0, 144.0}) {
        SCOPED_TRACE(rate);
        water.setInk(false);
        next();
        water.setInk(true);
        next();
        water.touch(TouchAction::down, 20, 30, 1.0f);
        const double start = now;
        while (count < 72) water.frame(now += 1.0 / rate);
        EXPECT_NEAR(now - start, 1.2, std::max(1.0 / rate, 1.0 / 60)) << "within a frame of the display or the ink";

        const int before = count;
        water.frame(now += 0.2);
        EXPECT_LE(count - before, 4) << "a late frame is not made up for without end";
        water.frame(now += 1.0 / 60);
        EXPECT_LE(count - before, 6) << "nor later";
    }
}

TEST_F(Live, longFramesMakeTheMeshCoarser) {
    water.resize(960, 540);
    next();
    for (int i = 0; i <= 20; ++i) water.noteWork(i == 0 ? 9.0 : 0.0);  // the first was the set-up's
    GLint bytes[2];
    for (GLint& size : bytes) {
        water.redraw();
        next();
        glBindBuffer(GL_ARRAY_BUFFER, fluid.v_buf);
        glGetBufferParameteriv(GL_ARRAY_BUFFER, GL_BUFFER_SIZE, &size);
        for (int i = 0; i < 20; ++i) water.noteWork(0.02);
    }
    EXPECT_EQ(bytes[0], 162 * 92 * 12) << "cells of 6 pixels, as many as the view shows";
    EXPECT_EQ(bytes[1], 123 * 69 * 12);
    GLint triangles;
    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, fluid.i_buf);
    glGetBufferParameteriv(GL_ELEMENT_ARRAY_BUFFER, GL_BUFFER_SIZE, &triangles);
    EXPECT_EQ(triangles, 122 * 68 * 12) << "no index too many";
}
