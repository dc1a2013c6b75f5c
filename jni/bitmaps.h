// The three bitmaps that the host hands over, as the texture loaders read them.
#pragma once

#include <android/bitmap.h>
#include <jni.h>

#include <cstdint>

extern AndroidBitmapInfo bmp_portrait_bg_info;
extern AndroidBitmapInfo bmp_landscape_bg_info;
extern AndroidBitmapInfo bmp_water_Info;
extern std::uint8_t* bmp_portrait_bg_Pixels;  // null until the first hand-over that succeeds
extern std::uint8_t* bmp_landscapebg_Pixels;
extern std::uint8_t* bmp_water_Pixels;

// Takes over `bitmap`, 32-bit RGBA without padding between rows, into one slot. A failure is logged and leaves
// the slot as the last successful hand-over filled it.
void transferBitmap(JNIEnv* env, jobject bitmap, AndroidBitmapInfo& info, std::uint8_t*& pixels);
