package javax.microedition.khronos.egl;

import javax.microedition.khronos.opengles.GL;

public class EGLContext {
    public static EGL egl;
    public final long handle;

    public EGLContext(long handle) {
        this.handle = handle;
    }

    public static EGL getEGL() {
        return egl;
    }

    public GL getGL() {
        return null;
    }
}
