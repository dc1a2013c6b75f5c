package com.zor.android.visualeffect.tidemark;

import android.opengl.GLSurfaceView;
import android.os.SystemClock;

import java.lang.reflect.Field;
import java.lang.reflect.Proxy;
import java.util.HashSet;
import java.util.Set;

import javax.microedition.khronos.egl.EGL10;
import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.egl.EGLContext;
import javax.microedition.khronos.egl.EGLDisplay;
import javax.microedition.khronos.egl.EGLSurface;
import javax.microedition.khronos.opengles.GL;

/**
 * What lies below the framework's GLSurfaceView: EGL's own calls, for windows without a screen. A frame that is shown
 * holds its GL thread until the test lets the next one come.
 */
final class Screen {
    static int refreshRate = 60;
    static int width;  // of the window, pixels
    static int height;
    private static final Set<Thread> HELD = new HashSet<>();
    private static boolean isOpen;
    private static int frames;
    private static byte[] pixels;

    private static final class Surface extends EGLSurface {
        final long handle = GlContext.createSurface(width, height);
    }

    private static final class Context extends EGLContext {
        final long handle = GlContext.createContext();

        @Override
        public GL getGL() {
            return null;
        }
    }

    static {
        EGLContext.egl = (EGL10) Proxy.newProxyInstance(Screen.class.getClassLoader(), new Class<?>[] {EGL10.class},
                (self, call, values) -> egl(call.getName(), values));
    }

    private Screen() {}

    private static Object egl(String call, Object[] values) {
        switch (call) {
            case "eglGetDisplay":
                return new EGLDisplay() {};
            case "eglChooseConfig":
                if (values[2] != null) ((EGLConfig[]) values[2])[0] = new EGLConfig() {};
                ((int[]) values[4])[0] = 1;
                return true;
            case "eglGetConfigAttrib":
                int which = (int) values[2];
                boolean isColor = which == EGL10.EGL_RED_SIZE || which == EGL10.EGL_GREEN_SIZE || which == EGL10.EGL_BLUE_SIZE;
                ((int[]) values[3])[0] = isColor ? 8 : 0;
                return true;
            case "eglCreateContext":
                return new Context();
            case "eglDestroyContext":
                GlContext.destroyContext(((Context) values[1]).handle);
                return true;
            case "eglCreateWindowSurface":
                return new Surface();
            case "eglDestroySurface":
                GlContext.destroySurface(((Surface) values[1]).handle);
                return true;
            case "eglMakeCurrent":
                return values[1] == null ? GlContext.makeCurrent(0, 0)
                        : GlContext.makeCurrent(((Surface) values[1]).handle, ((Context) values[3]).handle);
            case "eglSwapBuffers":
                show(GlContext.pixels(width, height));
                return true;
            case "eglGetError":
                return EGL10.EGL_SUCCESS;
            default:  // eglInitialize, eglTerminate
                return true;
        }
    }

    private static synchronized void show(byte[] frame) {
        pixels = frame;
        ++frames;
        SystemClock.nanos += 1000000000 / refreshRate;
        HELD.add(Thread.currentThread());
        while (!isOpen && HELD.contains(Thread.currentThread())) {
            try {
                Screen.class.wait();
            } catch (InterruptedException e) {
                throw new AssertionError(e);
            }
        }
        HELD.remove(Thread.currentThread());
    }

    /** Of the last frame: R, G, B, A, rows from the bottom. */
    static synchronized byte[] pixels() {
        return pixels;
    }

    /** Shown so far. */
    static synchronized int frames() {
        return frames;
    }

    /** Frames come as they like while the platform calls the view, which may wait for them. */
    static void during(GLSurfaceView view, Runnable calls) {
        open(true);
        calls.run();
        open(false);
        await(view);
    }

    private static synchronized void open(boolean isOpen) {
        Screen.isOpen = isOpen;
        Screen.class.notifyAll();
    }

    /** Lets the view's next frame come, and says whether there was one to wait for. */
    static boolean goOn(GLSurfaceView view) {
        Thread thread = await(view);
        synchronized (Screen.class) {
            if (!HELD.remove(thread)) return false;
            Screen.class.notifyAll();
        }
        await(view);
        return true;
    }

    private static synchronized boolean isHeld(Thread thread) {
        return HELD.contains(thread);
    }

    // Until the view's thread shows a frame or has nothing to do.
    private static Thread await(GLSurfaceView view) {
        try {
            Field field = GLSurfaceView.class.getDeclaredField("mGLThread");
            field.setAccessible(true);
            Thread thread = (Thread) field.get(view);
            while (thread.isAlive() && !isHeld(thread) && thread.getState() != Thread.State.WAITING) {
                Thread.sleep(0, 100000);
            }
            return thread;
        } catch (ReflectiveOperationException | InterruptedException e) {
            throw new AssertionError(e);
        }
    }
}
