#include "host/host_jni.h"

#include <algorithm>

namespace {

template <class Array, class Element, class Reference>
Element* JNICALL getElements(JNIEnv*, Reference reference, jboolean* isCopy) {
    if (isCopy) *isCopy = JNI_TRUE;
    auto* const array = static_cast<Array*>(reference);
    // An array without elements has an address as well, as in a virtual machine.
    array->pinned.reserve(std::max<std::size_t>(array->values.size(), 1));
    array->pinned = array->values;
    ++array->pins;
    return array->pinned.data();
}

template <class Array, class Element, class Reference>
void JNICALL releaseElements(JNIEnv*, Reference reference, Element*, jint mode) {
    auto* const array = static_cast<Array*>(reference);
    if (mode != JNI_ABORT) array->values = array->pinned;
    --array->pins;
}

}  // namespace

JNIEnv* hostEnvironment() {
    static const JNINativeInterface_ functions = [] {
        JNINativeInterface_ table = {};
        table.GetFloatArrayElements = getElements<FloatArray, jfloat, jfloatArray>;
        table.GetShortArrayElements = getElements<ShortArray, jshort, jshortArray>;
        table.ReleaseFloatArrayElements = releaseElements<FloatArray, jfloat, jfloatArray>;
        table.ReleaseShortArrayElements = releaseElements<ShortArray, jshort, jshortArray>;
        return table;
    }();
    static JNIEnv environment = {&functions};
    return &environment;
}
