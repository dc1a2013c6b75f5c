#include <gtest/gtest.h>

#include <cstring>
#include <numeric>
#include <tuple>

#include "jni/bitmaps.h"
#include "platform/desktop_bitmap.h"
#include "tests/support/frame.h"
#include "tests/support/log_recorder.h"

TEST(Natives, takeOverABitmapAndKeepItWhenTheNextOneFails) {
    using Transfer = void (*)(JNIEnv*, jobject, jobject);
    for (const auto& [transfer, info, kept] :
         {std::tuple<Transfer, AndroidBitmapInfo&, std::uint8_t*&>(
              native::transferPortraitBGBitmap, bmp_portrait_bg_info, bmp_portrait_bg_Pixels),
          {native::transferLandscapeBGBitmap, bmp_landscape_bg_info, bmp_landscapebg_Pixels},
          {native::transferWaterBitmap, bmp_water_Info, bmp_water_Pixels}}) {
        std::vector<std::uint8_t> pixels(2 * 3 * 4);
        std::iota(pixels.begin(), pixels.end(), std::uint8_t{100});
        const auto original = pixels;
        DesktopBitmap good, narrow, locked;
        good.info.width = narrow.info.width = locked.info.width = 2;
        good.info.height = 3;
        good.pixels = pixels.data();
        narrow.info.stride = 4;
        LogRecorder log;
        for (DesktopBitmap* const bitmap : {&good, &narrow, &locked, static_cast<DesktopBitmap*>(nullptr)}) {
            transfer(copyingEnvironment(), nullptr, bitmap);
            EXPECT_TRUE(!bitmap || bitmap->locks == 0);
            EXPECT_EQ(std::pair(info.width, info.height), std::pair(2u, 3u));
            EXPECT_EQ(std::memcmp(kept, original.data(), original.size()), 0);
            std::ranges::fill(pixels, std::uint8_t{0});  // recycled at once
        }
        const std::vector<std::string> lines = {
            "E not a 32-bit bitmap: 4 bytes for 2 pixels", "E AndroidBitmap_lockPixels () failed! error = -3",
            "E AndroidBitmap_getInfo () failed! error = -1"};
        EXPECT_EQ(log.take(), lines);
    }
}

// A virtual machine may have no address for an array without elements.
TEST(Natives, fillWhatHasElementsBesideWhatHasNone) {
    JNINativeInterface_ functions = *copyingEnvironment()->functions;
    JNIEnv sparing = {&functions};
    FloatArray none(0), one(3);
    ShortArray cells(6), noCells(0);
    functions.GetFloatArrayElements = [](JNIEnv*, jfloatArray, jboolean*) -> jfloat* { return nullptr; };
    native::initWaters(&sparing, nullptr, &none, &cells, 0, 2, 2, 2, 2);
    EXPECT_EQ(cells.values, (std::vector<jshort>{0, 1, 3, 0, 3, 2}));
    functions = *copyingEnvironment()->functions;
    functions.GetShortArrayElements = [](JNIEnv*, jshortArray, jboolean*) -> jshort* { return nullptr; };
    native::initWaters(&sparing, nullptr, &one, &noCells, 1, 2, 2, 3, 1);
    EXPECT_EQ(one.values[0], -1.0f);
}
