// The host's arrays for the length of one native call.
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

// The elements of an array, or null: for a null array, without memory for a copy, or, on some virtual machines, for an
// array without elements.
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

// Pins the arrays, calls use(complete, elements...), and copies them back, all in the order given. `complete` tells
// whether each array of which the call uses elements has an address. After the first one that has none, no further one
// is pinned, as an OutOfMemoryError may be pending, and the log names `method` the first time.
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
