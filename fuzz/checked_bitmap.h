// Takes the place of the bitmap library: bitmaps that fail at any step, and whose pixels end where they should.
#pragma once

#include <android/bitmap.h>

#include <cstdint>
#include <memory>

struct CheckedBitmap : _jobject {
    AndroidBitmapInfo info = {};
    int infoResult = ANDROID_BITMAP_RESULT_SUCCESS;
    int lockResult = ANDROID_BITMAP_RESULT_SUCCESS;
    std::unique_ptr<std::uint8_t[]> pixels;  // null locks without an address
    int locks = 0;                           // locks not yet undone
};
