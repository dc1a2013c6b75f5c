#include "fuzz/checked_jni.h"

#include <algorithm>
#include <cstdlib>
#include <vector>

#include "fuzz/require.h"

namespace {

struct Pin {
    const void* array;
    void* block;
    bool operator==(const Pin&) const = default;
};

std::vector<Pin> pins;

template <class Array, class Element, class Reference>
Element* JNICALL pin(JNIEnv*, Reference reference, jboolean* isCopy) {
    require(reference, "a null array is pinned");
    if (isCopy) *isCopy = JNI_TRUE;
    const auto* const array = static_cast<const Array*>(reference);
    if (!array->pinnable) return nullptr;
    auto* const block = static_cast<Element*>(std::malloc(array->length * sizeof(Element)));
    std::fill_n(block, array->length, array->content);
    pins.push_back({reference, block});
    return block;
}

template <class Element, class Reference>
void JNICALL release(JNIEnv*, Reference reference, Element* block, jint mode) {
    const auto found = std::find(pins.begin(), pins.end(), Pin{reference, block});
    require(found != pins.end(), "an array is released that was not pinned, or with another's pointer");
    require(mode == 0 || mode == JNI_ABORT, "an array stays pinned after its release");
    pins.erase(found);
    std::free(block);
}

}  // namespace

JNIEnv* checkedEnvironment() {
    static const JNINativeInterface_ functions = [] {
        JNINativeInterface_ table = {};
        table.GetFloatArrayElements = pin<CheckedFloats, jfloat, jfloatArray>;
        table.GetShortArrayElements = pin<CheckedShorts, jshort, jshortArray>;
        table.ReleaseFloatArrayElements = release<jfloat, jfloatArray>;
        table.ReleaseShortArrayElements = release<jshort, jshortArray>;
        return table;
    }();
    static JNIEnv environment = {&functions};
    return &environment;
}

void requireNothingPinned() {
    require(pins.empty(), "an array is still pinned");
}
