package com.zor.android.visualeffect.tidemark;

import java.nio.ByteBuffer;

/** OpenGL ES 2.0 without a window. */
final class GlContext {
    static {
        System.loadLibrary("tidemark_jvm_gl");
    }

    private static long context;
    private static long surface;

    private GlContext() {}

    /** A new context, current on this thread, with a framebuffer of this size. */
    static void open(int width, int height) {
        release();
        context = createContext();
        surface = createSurface(width, height);
        if (!makeCurrent(surface, context)) throw new IllegalStateException("no OpenGL ES 2.0 driver");
    }

    static void release() {
        if (context == 0) return;
        makeCurrent(0, 0);
        destroySurface(surface);
        destroyContext(context);
        context = 0;
    }

    /** R, G, B, A, rows from the bottom. */
    static byte[] pixels(int width, int height) {
        ByteBuffer buffer = ByteBuffer.allocateDirect(4 * width * height);
        readPixels(width, height, buffer);
        byte[] pixels = new byte[buffer.capacity()];
        buffer.get(pixels);
        return pixels;
    }

    /** What the library has logged since the last call, a line each. */
    static native String takeLog();

    static native long createContext();

    static native void destroyContext(long context);

    static native long createSurface(int width, int height);

    static native void destroySurface(long surface);

    static native boolean makeCurrent(long surface, long context);

    private static native void readPixels(int width, int height, ByteBuffer rgba);
}
