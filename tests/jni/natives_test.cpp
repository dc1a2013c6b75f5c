#include <gtest/gtest.h>

#include <cstring>
#include <numeric>

#include "jni/bitmaps.h"
#include "platform/desktop_bitmap.h"
#include "tests/support/frame.h"
#include "tests/support/log_recorder.h"

using namespace tidemark;

TEST(Natives, copyBitmapsAndKeepTheirPixelsOnFailure) {
    struct Slot {
        void (*transfer)(JNIEnv*, jobject, jobject);
        AndroidBitmapInfo& info;
        std::uint8_t*& kept;
    };
    for (const Slot& slot :
         {Slot{native::transferPortraitBGBitmap, bmp_portrait_bg_info, bmp_portrait_bg_Pixels},
          Slot{native::transferLandscapeBGBitmap, bmp_landscape_bg_info, bmp_landscapebg_Pixels},
          Slot{native::transferWaterBitmap, bmp_water_Info, bmp_water_Pixels}}) {
        std::vector<std::uint8_t> pixels(4 * 4 * 4);
        LogRecorder log;
        const auto handOver = [&](unsigned width, unsigned height, bool locks, unsigned stride = 7, int format = 0) {
            std::iota(pixels.begin(), pixels.end(), std::uint8_t{100});
            DesktopBitmap bitmap;
            bitmap.info.width = width;
            bitmap.info.height = height;
            bitmap.info.stride = stride;
            bitmap.info.format = format;
            if (locks) bitmap.pixels = pixels.data();
            slot.transfer(copyingEnvironment(), nullptr, &bitmap);
            EXPECT_EQ(bitmap.locks, 0);
            EXPECT_EQ(std::pair(slot.info.width, slot.info.height), std::pair(width, height));
            std::ranges::fill(pixels, std::uint8_t{0});  // The host recycles the bitmap.
        };
        const auto holds = [&slot](int count, int zeros) {
            int right = 0;
            for (int i = 0; i < count + zeros; ++i) right += slot.kept[i] == (i < count ? 100 + i : 0);
            return right == count + zeros;
        };
        handOver(4, 2, false);
        EXPECT_EQ(slot.kept, nullptr) << "no bitmap was ever locked";
        handOver(2, 3, true);
        EXPECT_TRUE(holds(2 * 3 * 4, 0)) << "the stride is ignored";
        handOver(1, 3, false);
        handOver(4, 3, false);
        EXPECT_TRUE(holds(2 * 3 * 4, 2 * 3 * 4)) << "the new size is filled with zeros";
        handOver(4, 4, true, 8, ANDROID_BITMAP_FORMAT_RGB_565);
        EXPECT_TRUE(holds(4 * 4 * 2, 4 * 4 * 2)) << "a 16-bit bitmap is read to its end, then zeros follow";
        const std::uint8_t* const before = slot.kept;
        slot.transfer(copyingEnvironment(), nullptr, nullptr);
        EXPECT_EQ(slot.kept, before);
        handOver(1u << 31, 1u << 31, false);
        EXPECT_EQ(slot.kept, nullptr) << "no allocation can be that large";
        const std::string lock = "E AndroidBitmap_lockPixels () failed! error = -3";
        const std::vector<std::string> lines = {lock, lock,
                                                lock, "E AndroidBitmap_getInfo () failed! error = -1",
                                                lock, "E cannot copy a bitmap of 2147483648 x 2147483648"};
        EXPECT_EQ(log.take(), lines);
    }
}

// A VM may return null for an empty array; the other array is still filled.
TEST(Natives, fillOneArrayIfTheOtherIsEmpty) {
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
