package javax.microedition.khronos.egl;

import javax.microedition.khronos.opengles.GL;

public abstract class EGLContext {
    public static EGL egl;

    public static EGL getEGL() {
        return egl;
    }

    public abstract GL getGL();
}
