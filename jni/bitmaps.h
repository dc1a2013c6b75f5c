// The three bitmaps that the host hands over, as the texture loaders read them.
#pragma once

#include <android/bitmap.h>
#include <jni.h>

#include <cstddef>
#include <cstdint>

extern AndroidBitmapInfo bmp_portrait_bg_info;
extern AndroidBitmapInfo bmp_landscape_bg_info;
extern AndroidBitmapInfo bmp_water_Info;
extern std::uint8_t* bmp_portrait_bg_Pixels;  // null until the first hand-over that succeeds
extern std::uint8_t* bmp_landscapebg_Pixels;
extern std::uint8_t* bmp_water_Pixels;

// One of the three pairs of variables above. `pixels` is a copy of `bytes` bytes, or null, and never smaller than
// `info` says.
struct BitmapSlot {
    AndroidBitmapInfo& info;
    std::uint8_t*& pixels;
    std::size_t bytes = 0;
};

extern BitmapSlot portraitSlot;
extern BitmapSlot landscapeSlot;
extern BitmapSlot waterSlot;

// Copies `bitmap`, 32-bit RGBA without padding between rows, into a slot. A failure is logged. The platform writes the
// slot's size before it locks the pixels: after a failed lock the slot has the new size and the earlier pixels,
// followed by zeros where the new size needs more.
void transferBitmap(JNIEnv* env, jobject bitmap, BitmapSlot& slot);
