package android.opengl;

/** EGL with one configuration, on the driver that a test sets. */
public class EGL14 {
    public interface Driver {
        long createContext();

        void destroyContext(long context);

        boolean makeCurrent(long context);

        boolean swapBuffers();
    }

    private static final class Context extends EGLContext {
        private long handle;
    }

    public static final EGLContext EGL_NO_CONTEXT = null;
    public static final EGLSurface EGL_NO_SURFACE = null;
    public static Driver driver;

    public static EGLDisplay eglGetDisplay(int name) {
        return new EGLDisplay() {};
    }

    public static boolean eglInitialize(EGLDisplay display, int[] major, int at, int[] minor, int also) {
        return driver != null;
    }

    public static boolean eglChooseConfig(EGLDisplay display, int[] wanted, int at, EGLConfig[] configs, int first,
            int most, int[] count, int also) {
        configs[0] = new EGLConfig() {};
        count[0] = 1;
        return true;
    }

    public static boolean eglGetConfigAttrib(EGLDisplay display, EGLConfig config, int name, int[] value, int at) {
        value[at] = 8;
        return true;
    }

    public static EGLContext eglCreateContext(EGLDisplay display, EGLConfig config, EGLContext other, int[] list, int at) {
        Context context = new Context();
        context.handle = driver.createContext();
        return context;
    }

    public static boolean eglDestroyContext(EGLDisplay display, EGLContext context) {
        driver.destroyContext(((Context) context).handle);
        return true;
    }

    public static EGLSurface eglCreateWindowSurface(EGLDisplay display, EGLConfig config, Object window, int[] list, int at) {
        return new EGLSurface() {};
    }

    public static boolean eglDestroySurface(EGLDisplay display, EGLSurface surface) {
        return true;
    }

    public static boolean eglMakeCurrent(EGLDisplay display, EGLSurface draw, EGLSurface read, EGLContext context) {
        return driver.makeCurrent(context == null ? 0 : ((Context) context).handle);
    }

    public static boolean eglSwapInterval(EGLDisplay display, int interval) {
        return true;
    }

    public static boolean eglSwapBuffers(EGLDisplay display, EGLSurface surface) {
        return driver.swapBuffers();
    }

    /** Returns the error of a lost context. */
    public static int eglGetError() {
        return 0x300e;
    }
}
