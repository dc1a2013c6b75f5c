// The desktop's <jni.h>, with the subset of Java's that this project uses, so that it builds without a JDK. A library
// built with it also runs under a Java VM: each function has its place in the VM's table.
#pragma once

#include <cstdint>

#define JNIEXPORT __attribute__((visibility("default")))
#define JNICALL

#define JNI_FALSE 0
#define JNI_TRUE 1
#define JNI_COMMIT 1
#define JNI_ABORT 2

using jboolean = std::uint8_t;
using jshort = std::int16_t;
using jint = std::int32_t;
using jlong = std::int64_t;
using jfloat = float;
using jdouble = double;

struct _jobject {};
struct _jclass : _jobject {};
struct _jarray : _jobject {};
struct _jshortArray : _jarray {};
struct _jfloatArray : _jarray {};
using jobject = _jobject*;
using jclass = _jclass*;
using jarray = _jarray*;
using jshortArray = _jshortArray*;
using jfloatArray = _jfloatArray*;

struct JNIEnv_;
using JNIEnv = JNIEnv_;

struct JNINativeInterface_ {
    void* before[186];
    jshort* (*GetShortArrayElements)(JNIEnv*, jshortArray, jboolean*);  // 186
    void* ints[2];
    jfloat* (*GetFloatArrayElements)(JNIEnv*, jfloatArray, jboolean*);  // 189
    void* doubles[4];
    void (*ReleaseShortArrayElements)(JNIEnv*, jshortArray, jshort*, jint);  // 194
    void* releases[2];
    void (*ReleaseFloatArrayElements)(JNIEnv*, jfloatArray, jfloat*, jint);  // 197
};

struct JNIEnv_ {
    const JNINativeInterface_* functions;

    jshort* GetShortArrayElements(jshortArray array, jboolean* isCopy) {
        return functions->GetShortArrayElements(this, array, isCopy);
    }
    jfloat* GetFloatArrayElements(jfloatArray array, jboolean* isCopy) {
        return functions->GetFloatArrayElements(this, array, isCopy);
    }
    void ReleaseShortArrayElements(jshortArray array, jshort* elements, jint mode) {
        functions->ReleaseShortArrayElements(this, array, elements, mode);
    }
    void ReleaseFloatArrayElements(jfloatArray array, jfloat* elements, jint mode) {
        functions->ReleaseFloatArrayElements(this, array, elements, mode);
    }
};
