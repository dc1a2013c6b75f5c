// Java's arrays and the four calls of the Java Native Interface that the library makes, for a host in C++.
#pragma once

#include <jni.h>

#include <cstddef>
#include <vector>

template <class Reference, class Element>
struct HostArray : Reference {
    explicit HostArray(std::size_t length) : values(length) {}
    std::vector<Element> values;
    std::vector<Element> pinned;  // what the library works on between Get...Elements and Release...Elements
    int pins = 0;                 // Gets not yet followed by their Release
};

using FloatArray = HostArray<_jfloatArray, jfloat>;
using ShortArray = HostArray<_jshortArray, jshort>;

// An environment whose array calls take the arrays above. It hands out copies and copies them back on release, as a
// virtual machine with a moving collector does.
JNIEnv* hostEnvironment();
