#include "fuzz/checked_bitmap.h"

#include "fuzz/require.h"

int AndroidBitmap_getInfo(JNIEnv*, jobject jbitmap, AndroidBitmapInfo* info) {
    if (!jbitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    const auto* const bitmap = static_cast<CheckedBitmap*>(jbitmap);
    if (bitmap->infoResult == ANDROID_BITMAP_RESULT_SUCCESS) *info = bitmap->info;
    return bitmap->infoResult;
}

int AndroidBitmap_lockPixels(JNIEnv*, jobject jbitmap, void** addrPtr) {
    if (!jbitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    auto* const bitmap = static_cast<CheckedBitmap*>(jbitmap);
    if (bitmap->lockResult != ANDROID_BITMAP_RESULT_SUCCESS) return bitmap->lockResult;
    ++bitmap->locks;
    *addrPtr = bitmap->pixels.get();
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

int AndroidBitmap_unlockPixels(JNIEnv*, jobject jbitmap) {
    if (!jbitmap) return ANDROID_BITMAP_RESULT_BAD_PARAMETER;
    auto* const bitmap = static_cast<CheckedBitmap*>(jbitmap);
    require(bitmap->locks > 0, "a bitmap is unlocked that is not locked");
    --bitmap->locks;
    return ANDROID_BITMAP_RESULT_SUCCESS;
}
