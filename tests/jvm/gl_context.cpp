// The native half of GlContext.java.
#include <GLES2/gl2.h>

#include <memory>
#include <string>

#include "com_zor_android_visualeffect_tidemark_GlContext.h"
#include "platform/headless_context.h"
#include "tests/support/log_recorder.h"

static std::unique_ptr<HeadlessContext> context;
static LogRecorder recorder;

JNIEXPORT jstring JNICALL
Java_com_zor_android_visualeffect_tidemark_GlContext_renew(JNIEnv* env, jclass, jint width, jint height) {
    std::string error;
    context.reset();
    context = HeadlessContext::create(width, height, error);
    return context ? nullptr : env->NewStringUTF(error.c_str());
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_GlContext_readPixels(
    JNIEnv* env, jclass, jint width, jint height, jobject rgba) {
    glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, env->GetDirectBufferAddress(rgba));
}

JNIEXPORT jstring JNICALL Java_com_zor_android_visualeffect_tidemark_GlContext_takeLog(JNIEnv* env, jclass) {
    std::string text;
    for (const std::string& line : recorder.take()) text += line + '\n';
    return env->NewStringUTF(text.c_str());
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_GlContext_release(JNIEnv*, jclass) {
    context.reset();
}
