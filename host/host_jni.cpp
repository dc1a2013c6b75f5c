#include "host/host_jni.h"

#include <type_traits>

namespace tidemark {

namespace {

template <class Array, class Element, class Reference>
Element* JNICALL getElements(JNIEnv*, Reference reference, jboolean* isCopy) {
    if (isCopy) *isCopy = JNI_FALSE;
    return static_cast<Array*>(reference)->values.data();
}

template <class Element, class Reference>
void JNICALL releaseElements(JNIEnv*, Reference, Element*, jint) {}

}  // namespace

JNIEnv* hostEnvironment() {
    // The table's type has different names in the headers of different platforms.
    using Functions = std::remove_cvref_t<decltype(*JNIEnv::functions)>;
    static constexpr Functions functions = [] {
        Functions table = {};
        table.GetFloatArrayElements = getElements<FloatArray, jfloat, jfloatArray>;
        table.GetShortArrayElements = getElements<ShortArray, jshort, jshortArray>;
        table.ReleaseFloatArrayElements = releaseElements;
        table.ReleaseShortArrayElements = releaseElements;
        return table;
    }();
    static JNIEnv environment = {&functions};
    return &environment;
}

}  // namespace tidemark
