// Access to the host's arrays during one native call.
#pragma once

#include <jni.h>

#include <tuple>

#include "base/log.h"

// An array and the number of its elements that the call uses.
template <class Array>
struct Argument {
    Array array;
    int count;
};
template <class Array>
Argument(Array, int) -> Argument<Array>;

// Returns the elements, or null for a null array, if the VM has no memory for a copy, and on some VMs for an empty
// array.
inline jfloat* pin(JNIEnv* env, jfloatArray array) {
    return array ? env->GetFloatArrayElements(array, nullptr) : nullptr;
}

inline jshort* pin(JNIEnv* env, jshortArray array) {
    return array ? env->GetShortArrayElements(array, nullptr) : nullptr;
}

inline void release(JNIEnv* env, jfloatArray array, jfloat* elements) {
    if (elements) env->ReleaseFloatArrayElements(array, elements, 0);
}

inline void release(JNIEnv* env, jshortArray array, jshort* elements) {
    if (elements) env->ReleaseShortArrayElements(array, elements, 0);
}

// Pins the arrays in order, calls use(complete, elements...) and releases them in the same order. `complete` is false
// if an array whose elements are needed could not be pinned. The remaining arrays are then not pinned, because an
// OutOfMemoryError may be pending. The first such failure of `method` is logged.
template <class Use, class... Arrays>
void withPinned(JNIEnv* env, const char* method, Use use, Argument<Arrays>... arguments) {
    static bool reported = false;
    bool complete = true;
    const auto pinNext = [&](auto argument) {
        auto* const elements = complete ? pin(env, argument.array) : nullptr;
        complete = complete && (elements || argument.count < 1);
        return elements;
    };
    const std::tuple pinned{pinNext(arguments)...};
    if (!complete && !reported) LOG_ERROR("%s() without an array", method);
    reported = reported || !complete;
    std::apply(
        [&](auto*... elements) {
            use(complete, elements...);
            (release(env, arguments.array, elements), ...);
        },
        pinned);
}
