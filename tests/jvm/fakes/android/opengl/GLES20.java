package android.opengl;

public class GLES20 {
    /** What the driver says that its largest texture is. */
    public static int largestTexture = 2048;

    public static int clears;

    public static void glClear(int mask) {
        ++clears;
    }

    public static void glGetIntegerv(int name, int[] value, int offset) {
        value[offset] = largestTexture;
    }
}
