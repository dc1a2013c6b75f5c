package com.zor.android.visualeffect.tidemark;

import java.nio.ByteBuffer;

/** An OpenGL ES 2.0 context without a window, current on the thread that made it. */
final class GlContext {
    static {
        System.loadLibrary("tidemark_jvm_gl");
    }

    private GlContext() {}

    static void open(int width, int height) {
        String problem = renew(width, height);
        if (problem != null) throw new IllegalStateException(problem);
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

    static native void release();

    private static native String renew(int width, int height);

    private static native void readPixels(int width, int height, ByteBuffer rgba);
}
