// The host's arrays for the length of one native call.
#pragma once

#include <jni.h>

#include <tuple>

#include "base/log.h"

// The elements of an array; null for a null array, or when the virtual machine has no memory for its copy.
inline jfloat* pin(JNIEnv* env, jfloatArray array) {
    return array ? env->GetFloatArrayElements(array, nullptr) : nullptr;
}

inline jshort* pin(JNIEnv* env, jshortArray array) {
    return array ? env->GetShortArrayElements(array, nullptr) : nullptr;
}

inline void release(JNIEnv* env, jfloatArray array, jfloat* elements) {
    env->ReleaseFloatArrayElements(array, elements, 0);
}

inline void release(JNIEnv* env, jshortArray array, jshort* elements) {
    env->ReleaseShortArrayElements(array, elements, 0);
}

// Names in the log, the first time, a method that could not work.
inline void reportMissingArray(const char* method, bool& reported) {
    if (!reported) LOG_ERROR("%s() without an array", method);
    reported = true;
}

// Pins the arrays, calls `use` with their elements, and copies them back, all in the order given. Where an array is
// null or the virtual machine has no memory for its copy, no further one is asked for, `use` is not called, and the log
// names `method` the first time.
template <class Use, class... Arrays>
void withPinned(JNIEnv* env, const char* method, Use use, Arrays... arrays) {
    static bool reported = false;
    std::tuple<decltype(pin(env, arrays))...> pinned;
    std::apply(
        [&](auto*&... elements) {
            ((elements = nullptr), ...);
            if ((... && (elements = pin(env, arrays)))) {
                use(elements...);
            } else {
                reportMissingArray(method, reported);
            }
            ((elements ? release(env, arrays, elements) : void()), ...);
        },
        pinned);
}
