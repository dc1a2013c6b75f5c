// The object behind a bitmap's jobject when no Java VM is running.
#pragma once

#include <android/bitmap.h>

struct DesktopBitmap : _jobject {
    AndroidBitmapInfo info = {};
    void* pixels = nullptr;  // not owned; null fails the lock
    int locks = 0;           // locks without their unlock
};
