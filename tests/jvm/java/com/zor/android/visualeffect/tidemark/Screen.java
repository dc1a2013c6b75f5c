package com.zor.android.visualeffect.tidemark;

import android.app.Activity;
import android.content.ComponentCallbacks;
import android.content.ComponentCallbacks2;
import android.content.Context;
import android.opengl.EGL14;
import android.opengl.GLES20;
import android.os.Looper;
import android.os.SystemClock;
import android.view.Choreographer;

import java.util.concurrent.CountDownLatch;

// The display of the tests, without a screen and with up to 160 x 160 pixels, and the threads of the views.
final class Screen {
    static volatile int refreshRate = 60;
    static volatile int width, height;
    static volatile int frames;  // shown so far
    static volatile byte[] pixels;  // of the last frame: R, G, B, A, rows from the bottom
    static volatile boolean isLost;  // the next frame loses the context
    static ComponentCallbacks2 process;

    static {
        EGL14.driver = new EGL14.Driver() {
            @Override
            public long createContext() {
                return GlContext.create(160, 160);
            }

            @Override
            public void destroyContext(long context) {
                GlContext.destroy(context);
            }

            @Override
            public boolean makeCurrent(long context) {
                return GlContext.makeCurrent(context);
            }

            @Override
            public boolean swapBuffers() {
                pixels = GlContext.pixels(width, height);
                ++frames;
                boolean isShown = !isLost;
                isLost = false;
                return isShown;
            }
        };
        GLES20.framebuffer = GlContext::pixels;
        GlThread.start(new Activity() {
            @Override
            public Context getApplicationContext() {
                return this;
            }

            @Override
            public void registerComponentCallbacks(ComponentCallbacks callbacks) {
                process = (ComponentCallbacks2) callbacks;
            }
        });
    }

    // Waits until no thread has anything to do.
    static void settle() {
        do {
            CountDownLatch decoded = new CountDownLatch(1);
            PictureLoader.post(decoded::countDown);
            try {
                decoded.await();
            } catch (InterruptedException e) {
                throw new AssertionError(e);
            }
            GlThread.await(() -> {});
        } while (Looper.runMain());
    }

    // Refreshes the display until a frame is shown. Returns false if no view requests a refresh.
    static boolean refreshUntilFrame() {
        int before = frames;
        do {
            settle();
            SystemClock.nanos += 1000000000 / refreshRate;
            if (!Choreographer.refresh(SystemClock.nanos)) return false;
            settle();
        } while (frames == before);
        return true;
    }
}
