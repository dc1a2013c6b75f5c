package com.zor.android.visualeffect.tidemark;

import android.opengl.EGL14;
import android.opengl.EGLConfig;
import android.opengl.EGLContext;
import android.opengl.EGLDisplay;
import android.opengl.EGLSurface;

/** The OpenGL ES 2.0 context that all views share. Call it on {@link GlThread} only. */
final class Egl {
    private static final int[] CONFIG = {EGL14.EGL_RENDERABLE_TYPE, EGL14.EGL_OPENGL_ES2_BIT, EGL14.EGL_SURFACE_TYPE,
        EGL14.EGL_WINDOW_BIT, EGL14.EGL_RED_SIZE, 8, EGL14.EGL_GREEN_SIZE, 8, EGL14.EGL_BLUE_SIZE, 8, EGL14.EGL_NONE};
    private static final int[] CONTEXT = {EGL14.EGL_CONTEXT_CLIENT_VERSION, 2, EGL14.EGL_NONE};
    private static final int[] SURFACE = {EGL14.EGL_NONE};

    private EGLDisplay display;
    private EGLConfig config;
    private EGLContext context;

    /** Makes the context where there is none. False where the device has no OpenGL ES 2.0. */
    boolean open() {
        if (context != null) return true;
        display = EGL14.eglGetDisplay(EGL14.EGL_DEFAULT_DISPLAY);
        int[] version = new int[2];
        if (!EGL14.eglInitialize(display, version, 0, version, 1)) return false;
        config = chooseConfig();
        if (config == null) return false;
        EGLContext made = EGL14.eglCreateContext(display, config, EGL14.EGL_NO_CONTEXT, CONTEXT, 0);
        if (made == null || made == EGL14.EGL_NO_CONTEXT) return false;
        context = made;
        return true;
    }

    // Deeper colours come first in the list, and cost time and memory that nobody sees.
    private EGLConfig chooseConfig() {
        EGLConfig[] configs = new EGLConfig[64];
        int[] count = new int[1];
        EGL14.eglChooseConfig(display, CONFIG, 0, configs, 0, configs.length, count, 0);
        EGLConfig usable = null;
        for (int i = 0; i < count[0]; ++i) {
            if (sizeOf(configs[i], EGL14.EGL_RED_SIZE) != 8) continue;
            if (sizeOf(configs[i], EGL14.EGL_ALPHA_SIZE) == 0) return configs[i];
            if (usable == null) usable = configs[i];
        }
        return usable;
    }

    private int sizeOf(EGLConfig candidate, int component) {
        int[] bits = new int[1];
        EGL14.eglGetConfigAttrib(display, candidate, component, bits, 0);
        return bits[0];
    }

    /** Null where the window has just gone. */
    EGLSurface surfaceOf(Object window) {
        try {
            EGLSurface made = EGL14.eglCreateWindowSurface(display, config, window, SURFACE, 0);
            return made == EGL14.EGL_NO_SURFACE ? null : made;
        } catch (IllegalArgumentException e) {
            return null;
        }
    }

    boolean makeCurrent(EGLSurface surface) {
        return EGL14.eglMakeCurrent(display, surface, surface, context);
    }

    /** A frame of the current surface takes the place of one that was not yet consumed. */
    void waitForNobody() {
        EGL14.eglSwapInterval(display, 0);
    }

    /** False where the context is lost or the window has gone. */
    boolean show(EGLSurface surface) {
        return EGL14.eglSwapBuffers(display, surface);
    }

    boolean isContextLost() {
        return EGL14.eglGetError() == EGL14.EGL_CONTEXT_LOST;
    }

    void destroy(EGLSurface surface) {
        leave();
        EGL14.eglDestroySurface(display, surface);
    }

    /** Frees the context and all that was made in it. */
    void close() {
        if (context == null) return;
        leave();
        EGL14.eglDestroyContext(display, context);
        context = null;
    }

    private void leave() {
        EGL14.eglMakeCurrent(display, EGL14.EGL_NO_SURFACE, EGL14.EGL_NO_SURFACE, EGL14.EGL_NO_CONTEXT);
    }
}
