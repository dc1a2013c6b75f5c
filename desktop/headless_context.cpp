#include "desktop/headless_context.h"

#define EGL_EGLEXT_PROTOTYPES
#include <EGL/egl.h>
#include <EGL/eglext.h>

#include "desktop/keep_driver.h"

std::unique_ptr<HeadlessContext> HeadlessContext::create(int width, int height, std::string& error) {
    const char* missing = "no OpenGL ES 2.0 driver: install Debian's packages libegl-mesa0 and libgl1-mesa-dri";
    std::unique_ptr<HeadlessContext> made(new HeadlessContext);
    const EGLDisplay display = eglGetPlatformDisplay(EGL_PLATFORM_SURFACELESS_MESA, EGL_DEFAULT_DISPLAY, nullptr);
    if (display == EGL_NO_DISPLAY || !eglInitialize(display, nullptr, nullptr)) {
        error = missing;
        return nullptr;
    }
    made->display_ = display;
    const EGLint wanted[] = {
        EGL_SURFACE_TYPE,
        EGL_PBUFFER_BIT,
        EGL_RENDERABLE_TYPE,
        EGL_OPENGL_ES2_BIT,
        EGL_RED_SIZE,
        8,
        EGL_GREEN_SIZE,
        8,
        EGL_BLUE_SIZE,
        8,
        EGL_ALPHA_SIZE,
        8,
        EGL_NONE};
    EGLConfig config = nullptr;
    EGLint count = 0;
    if (!eglBindAPI(EGL_OPENGL_ES_API) || !eglChooseConfig(display, wanted, &config, 1, &count) || count == 0) {
        error = missing;
        return nullptr;
    }
    const EGLint size[] = {EGL_WIDTH, width, EGL_HEIGHT, height, EGL_NONE};
    made->surface_ = eglCreatePbufferSurface(display, config, size);
    const EGLint version[] = {EGL_CONTEXT_CLIENT_VERSION, 2, EGL_NONE};
    made->context_ = eglCreateContext(display, config, EGL_NO_CONTEXT, version);
    if (made->surface_ == EGL_NO_SURFACE || made->context_ == EGL_NO_CONTEXT ||
        !eglMakeCurrent(display, made->surface_, made->surface_, made->context_)) {
        error = "the OpenGL ES 2.0 driver cannot draw a picture of " + std::to_string(width) + "x" +
                std::to_string(height) + " pixels";
        return nullptr;
    }
    keepDriverLoaded();
    return made;
}

HeadlessContext::~HeadlessContext() {
    if (!display_) return;
    eglMakeCurrent(display_, EGL_NO_SURFACE, EGL_NO_SURFACE, EGL_NO_CONTEXT);
    if (context_) eglDestroyContext(display_, context_);
    if (surface_) eglDestroySurface(display_, surface_);
    eglTerminate(display_);
}
