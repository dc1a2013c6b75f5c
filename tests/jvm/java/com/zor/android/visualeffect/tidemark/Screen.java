package com.zor.android.visualeffect.tidemark;

import android.opengl.GLSurfaceView;
import android.os.SystemClock;

import java.lang.reflect.Field;
import java.lang.reflect.Proxy;
import java.util.Set;
import java.util.concurrent.ConcurrentHashMap;

import javax.microedition.khronos.egl.*;

// What lies below the framework's GLSurfaceView: windows of up to 160 x 160 pixels without a screen. A frame that is
// shown holds its GL thread until the test lets the next one come.
final class Screen {
    static volatile int refreshRate = 60;
    static volatile int width, height;
    static volatile int frames;  // shown so far
    static volatile byte[] pixels;  // of the last one: R, G, B, A, rows from the bottom
    private static final Set<Thread.State> RESTING = Set.of(Thread.State.WAITING, Thread.State.TERMINATED);
    private static final Set<Thread> HELD = ConcurrentHashMap.newKeySet();
    static volatile boolean isLost;  // the context, as the next frame is shown
    private static volatile boolean isOpen;

    static {
        EGLContext.egl = (EGL10) Proxy.newProxyInstance(Screen.class.getClassLoader(), new Class<?>[] {EGL10.class},
                (self, method, values) -> call(method.getName(), values));
    }

    private static Object call(String name, Object[] values) throws InterruptedException {
        switch (name) {
            case "eglGetDisplay": return new EGLDisplay() {};
            case "eglCreateContext": return new EGLContext(GlContext.create(160, 160));
            case "eglCreateWindowSurface": return new EGLSurface() {};
            case "eglDestroyContext": GlContext.destroy(((EGLContext) values[1]).handle); break;
            case "eglSwapBuffers": show(); return !isLost;
            case "eglGetError": isLost = false; return EGL11.EGL_CONTEXT_LOST;
            case "eglMakeCurrent": return GlContext.makeCurrent(values[3] == null ? 0 : ((EGLContext) values[3]).handle);
            case "eglChooseConfig":
                if (values[2] != null) ((EGLConfig[]) values[2])[0] = new EGLConfig() {};
                ((int[]) values[4])[0] = 1;
                break;
            case "eglGetConfigAttrib":
                int bits = (int) values[2];
                ((int[]) values[3])[0] = bits >= EGL10.EGL_BLUE_SIZE && bits <= EGL10.EGL_RED_SIZE ? 8 : 0;
                break;
            default:  // eglInitialize, eglTerminate, eglDestroySurface
        }
        return true;
    }

    private static synchronized void show() throws InterruptedException {
        pixels = GlContext.pixels(width, height);
        ++frames;
        SystemClock.nanos += 1000000000 / refreshRate;
        HELD.add(Thread.currentThread());
        while (!isOpen && HELD.contains(Thread.currentThread())) Screen.class.wait();
        HELD.remove(Thread.currentThread());
    }

    // Frames come as they like while the platform calls the view, which may wait for them.
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

    // Lets the view's next frame come, and says whether there was one to wait for.
    static boolean goOn(GLSurfaceView view) {
        boolean wasHeld = HELD.remove(await(view));
        open(false);
        await(view);
        return wasHeld;
    }

    // Until the view's thread shows a frame or has nothing to do.
    private static Thread await(GLSurfaceView view) {
        try {
            Field field = GLSurfaceView.class.getDeclaredField("mGLThread");
            field.setAccessible(true);
            Thread thread = (Thread) field.get(view);
            while (!HELD.contains(thread) && !RESTING.contains(thread.getState())) Thread.sleep(1);
            return thread;
        } catch (ReflectiveOperationException | InterruptedException e) {
            throw new AssertionError(e);
        }
    }
}
