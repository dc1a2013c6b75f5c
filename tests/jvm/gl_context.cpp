// The native methods of GlContext.java: EGL on Mesa's software driver. Each context has a pbuffer.
#define EGL_EGLEXT_PROTOTYPES
#include <EGL/egl.h>
#include <EGL/eglext.h>
#include <GLES2/gl2.h>

#include <memory>
#include <string>

#include "com_zor_android_visualeffect_tidemark_GlContext.h"
#include "tests/support/log_recorder.h"

static const EGLDisplay display = eglGetPlatformDisplay(EGL_PLATFORM_SURFACELESS_MESA, EGL_DEFAULT_DISPLAY, nullptr);

static EGLConfig chooseConfig() {
    const EGLint wanted[] = {EGL_SURFACE_TYPE, EGL_PBUFFER_BIT, EGL_ALPHA_SIZE, 8, EGL_NONE};
    EGLConfig config = nullptr;
    EGLint count = 0;
    eglInitialize(display, nullptr, nullptr);
    eglChooseConfig(display, wanted, &config, 1, &count);
    return config;
}

static const EGLConfig config = chooseConfig();
static LogRecorder recorder;

struct Target {
    EGLContext context = EGL_NO_CONTEXT;
    EGLSurface surface = EGL_NO_SURFACE;
};

JNIEXPORT jlong JNICALL
Java_com_zor_android_visualeffect_tidemark_GlContext_create(JNIEnv*, jclass, jint width, jint height) {
    const EGLint size[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
    const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 2, EGL_NONE};
    eglBindAPI(EGL_OPENGL_ES_API);
    const EGLContext context = eglCreateContext(display, config, EGL_NO_CONTEXT, version);
    return reinterpret_cast<jlong>(new Target{context, eglCreatePbufferSurface(display, config, size)});
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_GlContext_destroy(JNIEnv*, jclass, jlong target) {
    const std::unique_ptr<Target> old(reinterpret_cast<Target*>(target));
    if (!old) return;
    eglDestroyContext(display, old->context);
    eglDestroySurface(display, old->surface);
}

JNIEXPORT jboolean JNICALL
Java_com_zor_android_visualeffect_tidemark_GlContext_makeCurrent(JNIEnv*, jclass, jlong target) {
    const Target none;
    const Target& next = target ? *reinterpret_cast<Target*>(target) : none;
    eglBindAPI(EGL_OPENGL_ES_API);
    return eglMakeCurrent(display, next.surface, next.surface, next.context) == EGL_TRUE;
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

JNIEXPORT jint JNICALL Java_com_zor_android_visualeffect_tidemark_GlContext_countObjects(JNIEnv*, jclass) {
    jint count = 0;
    for (GLuint name = 1; name < 1000; ++name) {
        for (const auto is : {glIsBuffer, glIsFramebuffer, glIsProgram, glIsShader, glIsTexture}) count += is(name);
    }
    return count;
}
