// Java's arrays, and an environment with the four JNI functions that the library calls, for a host in C++.
#pragma once

#include <jni.h>

#include <cstddef>
#include <vector>

namespace tidemark {

template <class Reference, class Element>
struct HostArray : Reference {
    explicit HostArray(std::size_t length) : values(length) {}
    std::vector<Element> values;
};

using FloatArray = HostArray<_jfloatArray, jfloat>;
using ShortArray = HostArray<_jshortArray, jshort>;

// Returns an environment whose functions accept the arrays above. They return the arrays' own elements, without a copy.
JNIEnv* hostEnvironment();

}  // namespace tidemark
