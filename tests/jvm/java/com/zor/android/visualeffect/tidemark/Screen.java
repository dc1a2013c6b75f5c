package com.zor.android.visualeffect.tidemark;

import android.opengl.GLSurfaceView;
import android.os.SystemClock;
import android.view.Choreographer;

import java.lang.reflect.Field;
import java.lang.reflect.Proxy;
import java.util.Set;

import javax.microedition.khronos.egl.*;

// What lies below the framework's GLSurfaceView: windows of up to 160 x 160 pixels without a screen.
final class Screen {
    static volatile int refreshRate = 60;
    static volatile int width, height;
    static volatile int frames;  // shown so far
    static volatile byte[] pixels;  // of the last one: R, G, B, A, rows from the bottom
    private static final Set<Thread.State> RESTING = Set.of(Thread.State.WAITING, Thread.State.TERMINATED);
    static volatile boolean isLost;  // the context, as the next frame is shown

    static {
        EGLContext.egl = (EGL10) Proxy.newProxyInstance(Screen.class.getClassLoader(), new Class<?>[] {EGL10.class},
                (self, method, values) -> call(method.getName(), values));
    }

    private static Object call(String name, Object[] values) {
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

    private static void show() {
        pixels = GlContext.pixels(width, height);
        ++frames;
    }

    // The platform calls the view, and may ask it for frames.
    static void during(GLSurfaceView view, Runnable calls) {
        calls.run();
        await(view);
    }

    // Lets the display refresh until the view has shown a frame, and says whether it wanted to.
    static boolean goOn(GLSurfaceView view) {
        int before = frames;
        do {
            SystemClock.nanos += 1000000000 / refreshRate;
            if (!Choreographer.getInstance().refresh(SystemClock.nanos)) return false;
            await(view);
        } while (frames == before);
        return true;
    }

    // Until the view's thread has nothing to do.
    private static void await(GLSurfaceView view) {
        try {
            Field field = GLSurfaceView.class.getDeclaredField("mGLThread");
            field.setAccessible(true);
            Thread thread = (Thread) field.get(view);
            while (!RESTING.contains(thread.getState())) Thread.sleep(1);
        } catch (ReflectiveOperationException | InterruptedException e) {
            throw new AssertionError(e);
        }
    }
}
