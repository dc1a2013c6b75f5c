// An environment that holds the library to the rules of the Java Native Interface: no null array is pinned, every
// pinned array is released once, with its own pointer, before the method returns. Each pin is a block of exactly the
// array's length, freed on release, so that the sanitizer sees an access beyond it or after it.
#pragma once

#include <jni.h>

#include <cstddef>

template <class Reference, class Element>
struct CheckedArray : Reference {
    std::size_t length = 0;
    Element content = {};  // of every element
    bool pinnable = true;  // a virtual machine without memory for the copy answers null
};

using CheckedFloats = CheckedArray<_jfloatArray, jfloat>;
using CheckedShorts = CheckedArray<_jshortArray, jshort>;

JNIEnv* checkedEnvironment();

// To be called when a native method has returned.
void requireNothingPinned();
