#include "host/host_jni.h"

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
    static const JNINativeInterface_ functions = [] {
        JNINativeInterface_ table = {};
        table.GetFloatArrayElements = getElements<FloatArray, jfloat, jfloatArray>;
        table.GetShortArrayElements = getElements<ShortArray, jshort, jshortArray>;
        table.ReleaseFloatArrayElements = releaseElements;
        table.ReleaseShortArrayElements = releaseElements;
        return table;
    }();
    static JNIEnv environment = {&functions};
    return &environment;
}
