package com.zor.android.visualeffect.tidemark;

import java.nio.ByteBuffer;

/** OpenGL ES 2.0 without a window. */
final class GlContext {
    static {
        System.loadLibrary("tidemark_jvm_gl");
    }

    private static long context;

    private GlContext() {}

    /** Creates a context with a framebuffer of this size and makes it current on this thread. */
    static void open(int width, int height) {
        release();
        context = create(width, height);
        if (!makeCurrent(context)) throw new IllegalStateException("no OpenGL ES 2.0 driver");
    }

    static void release() {
        makeCurrent(0);
        destroy(context);
        context = 0;
    }

    /** Returns the bytes R, G, B, A of the framebuffer, rows from the bottom. */
    static byte[] pixels(int width, int height) {
        ByteBuffer buffer = ByteBuffer.allocateDirect(4 * width * height);
        readPixels(width, height, buffer);
        byte[] pixels = new byte[buffer.capacity()];
        buffer.get(pixels);
        return pixels;
    }

    /** Returns the lines that the library has logged since the last call. */
    static native String takeLog();

    /** Counts the GL objects of the current context. */
    static native int countObjects();

    static native long create(int width, int height);

    static native void destroy(long context);

    static native boolean makeCurrent(long context);

    private static native void readPixels(int width, int height, ByteBuffer rgba);
}
