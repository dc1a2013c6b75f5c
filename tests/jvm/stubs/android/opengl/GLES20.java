package android.opengl;

public class GLES20 {
    public static final int GL_COLOR_BUFFER_BIT = 0x4000;

    public static int clears;

    public static void glClear(int mask) {
        ++clears;
    }
}
