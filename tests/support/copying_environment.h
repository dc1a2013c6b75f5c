// An environment that hands out copies and copies them back on release, as a virtual machine with a moving collector
// does. Each is a block of its array's very length.
#pragma once

#include <algorithm>

#include "host/host_jni.h"

inline int copiesOut = 0;  // not yet released

template <class Array, class Element, class Reference>
Element* copyElements(JNIEnv*, Reference reference, jboolean*) {
    const auto& values = static_cast<Array*>(reference)->values;
    auto* const copy = new Element[values.size()];
    std::ranges::copy(values, copy);
    ++copiesOut;
    return copy;
}

template <class Array, class Element, class Reference>
void copyBack(JNIEnv*, Reference reference, Element* copy, jint mode) {
    auto& values = static_cast<Array*>(reference)->values;
    if (mode != JNI_ABORT) std::copy_n(copy, values.size(), values.begin());
    delete[] copy;
    --copiesOut;
}

inline JNIEnv* copyingEnvironment() {
    static JNINativeInterface_ table;
    table.GetFloatArrayElements = copyElements<FloatArray, jfloat, jfloatArray>;
    table.GetShortArrayElements = copyElements<ShortArray, jshort, jshortArray>;
    table.ReleaseFloatArrayElements = copyBack<FloatArray, jfloat, jfloatArray>;
    table.ReleaseShortArrayElements = copyBack<ShortArray, jshort, jshortArray>;
    static JNIEnv environment = {&table};
    return &environment;
}
