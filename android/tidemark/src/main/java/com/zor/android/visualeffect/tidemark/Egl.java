package com.zor.android.visualeffect.tidemark;

import android.opengl.EGL14;
import android.opengl.EGLConfig;
import android.opengl.EGLContext;
import android.opengl.EGLDisplay;
import android.opengl.EGLSurface;

/** The OpenGL ES 2.0 context that all views share. Used on {@link GlThread} only. */
final class Egl {
    private static final int[] CONFIG = {EGL14.EGL_RENDERABLE_TYPE, EGL14.EGL_OPENGL_ES2_BIT, EGL14.EGL_SURFACE_TYPE,
        EGL14.EGL_WINDOW_BIT, EGL14.EGL_RED_SIZE, 8, EGL14.EGL_GREEN_SIZE, 8, EGL14.EGL_BLUE_SIZE, 8, EGL14.EGL_NONE};
    private static final int[] CONTEXT = {EGL14.EGL_CONTEXT_CLIENT_VERSION, 2, EGL14.EGL_NONE};
    private static final int[] SURFACE = {EGL14.EGL_NONE};

    private EGLDisplay display;
    private EGLConfig config;
    private EGLContext context;  // null while closed

    /** Creates the context if there is none. Returns false if the device has no OpenGL ES 2.0. */
    boolean open() {
        if (context != null) return true;
        display = EGL14.eglGetDisplay(EGL14.EGL_DEFAULT_DISPLAY);
        int[] version = new int[2];
        if (!EGL14.eglInitialize(display, version, 0, version, 1)) return false;
        config = chooseConfig();
        if (config == null) return false;
        EGLContext created = EGL14.eglCreateContext(display, config, EGL14.EGL_NO_CONTEXT, CONTEXT, 0);
        if (created != null && created != EGL14.EGL_NO_CONTEXT) context = created;
        return context != null;
    }

    // The list begins with more than 8 bits a colour, which would cost time and memory and look the same.
    private EGLConfig chooseConfig() {
        EGLConfig[] configs = new EGLConfig[64];
        int[] count = new int[1];
        EGL14.eglChooseConfig(display, CONFIG, 0, configs, 0, configs.length, count, 0);
        EGLConfig withAlpha = null;
        for (int i = 0; i < count[0]; ++i) {
            if (bits(configs[i], EGL14.EGL_RED_SIZE) != 8) continue;
            if (bits(configs[i], EGL14.EGL_ALPHA_SIZE) == 0) return configs[i];
            if (withAlpha == null) withAlpha = configs[i];
        }
        return withAlpha;
    }

    private int bits(EGLConfig candidate, int component) {
        int[] bits = new int[1];
        EGL14.eglGetConfigAttrib(display, candidate, component, bits, 0);
        return bits[0];
    }

    /** Returns null if the window no longer exists. */
    EGLSurface createSurface(Object window) {
        try {
            EGLSurface created = EGL14.eglCreateWindowSurface(display, config, window, SURFACE, 0);
            return created == EGL14.EGL_NO_SURFACE ? null : created;
        } catch (IllegalArgumentException e) {
            return null;
        }
    }

    boolean makeCurrent(EGLSurface surface) {
        return EGL14.eglMakeCurrent(display, surface, surface, context);
    }

    /** Lets a frame of the current surface replace the one before, if that was not shown yet. */
    void swapWithoutWaiting() {
        EGL14.eglSwapInterval(display, 0);
    }

    /** Shows the frame. Returns false if the context is lost or the window no longer exists. */
    boolean swap(EGLSurface surface) {
        return EGL14.eglSwapBuffers(display, surface);
    }

    boolean isContextLost() {
        return EGL14.eglGetError() == EGL14.EGL_CONTEXT_LOST;
    }

    void destroy(EGLSurface surface) {
        makeNoneCurrent();
        EGL14.eglDestroySurface(display, surface);
    }

    /** Frees the context and its objects. */
    void close() {
        if (context == null) return;
        makeNoneCurrent();
        EGL14.eglDestroyContext(display, context);
        context = null;
    }

    private void makeNoneCurrent() {
        EGL14.eglMakeCurrent(display, EGL14.EGL_NO_SURFACE, EGL14.EGL_NO_SURFACE, EGL14.EGL_NO_CONTEXT);
    }
}
