// The library writes to the platform's log only through these macros.
#pragma once

#include <android/log.h>

#define LOG_INFO(...) __android_log_print(ANDROID_LOG_INFO, "Tidemark_Native", __VA_ARGS__)
#define LOG_ERROR(...) __android_log_print(ANDROID_LOG_ERROR, "Tidemark_Native", __VA_ARGS__)
