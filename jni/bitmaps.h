// Copies of the three bitmaps that the host passes; the texture loaders read them.
#pragma once

#include <android/bitmap.h>
#include <jni.h>

#include <cstddef>
#include <cstdint>

extern AndroidBitmapInfo bmp_portrait_bg_info;
extern AndroidBitmapInfo bmp_landscape_bg_info;
extern AndroidBitmapInfo bmp_water_Info;
extern std::uint8_t* bmp_portrait_bg_Pixels;  // null until the first successful transfer
extern std::uint8_t* bmp_landscapebg_Pixels;
extern std::uint8_t* bmp_water_Pixels;

// References one pair of the variables above. `pixels` is null or an owned block of `bytes`, at least
// 4 * info.width * info.height.
struct BitmapSlot {
    AndroidBitmapInfo& info;
    std::uint8_t*& pixels;
    std::size_t bytes = 0;
};

extern BitmapSlot portraitSlot;
extern BitmapSlot landscapeSlot;
extern BitmapSlot waterSlot;

// Copies `bitmap`, RGBA8 without padding between rows, into `slot`. Logs a failure. If only the lock fails, the slot
// has the new bitmap's size and its earlier pixels, followed by zeros if the new size needs more.
void transferBitmap(JNIEnv* env, jobject bitmap, BitmapSlot& slot);
