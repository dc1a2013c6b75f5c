// A JNIEnv that returns copies of arrays and copies them back on release, as a VM with a moving collector does. Each
// copy is a block of exactly the array's size, so that a sanitizer detects an access beyond it.
#pragma once

#include <algorithm>

#include "host/host_jni.h"

inline int pinnedCopies = 0;  // copies not yet released

template <class Array, class Element>
Element* copyElements(JNIEnv*, auto reference, jboolean*) {
    const auto& values = static_cast<Array*>(reference)->values;
    auto* const copy = new Element[values.size()];
    std::ranges::copy(values, copy);
    ++pinnedCopies;
    return copy;
}

template <class Array>
void copyBack(JNIEnv*, auto reference, auto* copy, jint mode) {
    auto& values = static_cast<Array*>(reference)->values;
    if (mode != JNI_ABORT) std::copy_n(copy, values.size(), values.begin());
    delete[] copy;
    --pinnedCopies;
}

inline JNIEnv* copyingEnvironment() {
    static JNINativeInterface_ table = {};
    table.GetFloatArrayElements = copyElements<tidemark::FloatArray, jfloat>;
    table.GetShortArrayElements = copyElements<tidemark::ShortArray, jshort>;
    table.ReleaseFloatArrayElements = copyBack<tidemark::FloatArray>;
    table.ReleaseShortArrayElements = copyBack<tidemark::ShortArray>;
    static JNIEnv environment = {&table};
    return &environment;
}
