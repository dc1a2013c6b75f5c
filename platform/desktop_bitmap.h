// What a bitmap reference points to where no Java virtual machine runs.
#pragma once

#include <android/bitmap.h>

struct DesktopBitmap : _jobject {
    AndroidBitmapInfo info = {};
    void* pixels = nullptr;  // not owned; null fails the lock
    int locks = 0;           // locks not yet undone
};
