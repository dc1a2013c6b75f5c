// Java's arrays and the four calls of the Java Native Interface that the library makes, for a host in C++.
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

// An environment whose array calls take the arrays above. It hands out their own elements, as nothing moves them.
JNIEnv* hostEnvironment();

}  // namespace tidemark
