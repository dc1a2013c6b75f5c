#include "jni/natives.h"

#include <cstring>

#include "jni/bitmaps.h"
#include "platform/desktop_bitmap.h"
#include "tests/support/frame.h"
#include "tests/support/log_recorder.h"

#include <gtest/gtest.h>

TEST(Natives, takeOverABitmapAndKeepItWhenTheNextOneFails) {
    struct Slot {
        void (*transfer)(JNIEnv*, jobject, jobject);
        AndroidBitmapInfo& info;
        std::uint8_t*& pixels;
    };
    for (const Slot& slot :
         {Slot{NATIVE(transferPortraitBGBitmap), bmp_portrait_bg_info, bmp_portrait_bg_Pixels},
          {NATIVE(transferLandscapeBGBitmap), bmp_landscape_bg_info, bmp_landscapebg_Pixels},
          {NATIVE(transferWaterBitmap), bmp_water_Info, bmp_water_Pixels}}) {
        std::vector<std::uint8_t> pixels(2 * 3 * 4);
        for (std::size_t i = 0; i < pixels.size(); ++i) pixels[i] = static_cast<std::uint8_t>(i * 7);
        const auto original = pixels;
        LogRecorder log;
        const auto expectKept = [&](DesktopBitmap* bitmap, const std::vector<std::string>& lines) {
            slot.transfer(hostEnvironment(), nullptr, bitmap);
            EXPECT_EQ(log.take(), lines);
            EXPECT_TRUE(!bitmap || bitmap->locks == 0);
            EXPECT_EQ(std::pair(slot.info.width, slot.info.height), std::pair(2u, 3u));
        };
        DesktopBitmap bitmap;
        bitmap.info.width = 2;
        bitmap.info.height = 3;
        bitmap.pixels = pixels.data();
        expectKept(&bitmap, {});
        std::ranges::fill(pixels, std::uint8_t{0});  // recycled at once
        expectKept(nullptr, {"E AndroidBitmap_getInfo () failed! error = -1"});
        DesktopBitmap other = bitmap;
        other.info.width = 8;
        other.info.stride = 2 * 8;
        expectKept(&other, {"E not a 32-bit bitmap: 16 bytes for 8 pixels"});
        other.info.stride = 0;
        other.pixels = nullptr;
        expectKept(&other, {"E AndroidBitmap_lockPixels () failed! error = -3"});
        EXPECT_EQ(std::memcmp(slot.pixels, original.data(), original.size()), 0);
    }
}

// A virtual machine may have no address for an array without elements.
TEST(Natives, fillWhatHasElementsBesideWhatHasNone) {
    JNINativeInterface_ functions = *hostEnvironment()->functions;
    JNIEnv sparing = {&functions};
    FloatArray none(0), one(3);
    ShortArray cells(6), noCells(0);
    functions.GetFloatArrayElements = [](JNIEnv*, jfloatArray, jboolean*) -> jfloat* { return nullptr; };
    NATIVE(initWaters)(&sparing, nullptr, &none, &cells, 0, 2, 2, 2, 2);
    EXPECT_EQ(cells.values, (std::vector<jshort>{0, 1, 3, 0, 3, 2}));
    functions = *hostEnvironment()->functions;
    functions.GetShortArrayElements = [](JNIEnv*, jshortArray, jboolean*) -> jshort* { return nullptr; };
    NATIVE(initWaters)(&sparing, nullptr, &one, &noCells, 1, 2, 2, 3, 1);
    EXPECT_EQ(one.values[0], -1.0f);
}

TEST(Natives, workOnTheHostsArraysInPlace) {
    FloatArray velocity(64), height(64);
    NATIVE(ripple)(hostEnvironment(), nullptr, &velocity, 8, 8, 8, 8, 0.0f, 0.0f, 0.5f);
    EXPECT_EQ(velocity.values[4 * 8 + 4], 1.5f);
    const auto move = [&](jboolean check) {
        return NATIVE(move)(hostEnvironment(), nullptr, &velocity, &height, 1, 1, 7, 7, 8, 8, check, 0.5f, 0.0f);
    };
    EXPECT_EQ(move(JNI_TRUE), JNI_FALSE);
    EXPECT_EQ(velocity.values[4 * 8 + 4], 0.75f);
    EXPECT_GT(height.values[4 * 8 + 4], 0.5f);
    EXPECT_EQ(move(JNI_FALSE), JNI_TRUE);
}
