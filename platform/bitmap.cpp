#include <android/bitmap.h>

#include "platform/desktop_bitmap.h"

int AndroidBitmap_getInfo(JNIEnv*, jobject jbitmap, AndroidBitmapInfo* info) {
    if (!jbitmap || !info) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    *info = static_cast<DesktopBitmap*>(jbitmap)->info;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_lockPixels(JNIEnv*, jobject jbitmap, void** addrPtr) {
    if (!jbitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    auto* const bitmap = static_cast<DesktopBitmap*>(jbitmap);
    if (!bitmap->pixels) return ANDROID_BITMAP_RESULT_ALLOCATION_FAILED;
    ++bitmap->locks;
    if (addrPtr) *addrPtr = bitmap->pixels;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_unlockPixels(JNIEnv*, jobject jbitmap) {
    if (!jbitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    --static_cast<DesktopBitmap*>(jbitmap)->locks;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}
