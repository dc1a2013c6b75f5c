package com.zor.android.visualeffect.tidemark;

import android.content.ComponentCallbacks2;
import android.content.Context;
import android.content.res.Configuration;
import android.graphics.Bitmap;
import android.os.Handler;
import android.os.HandlerThread;
import android.os.Process;

import java.util.ArrayList;
import java.util.List;
import java.util.concurrent.CountDownLatch;

/**
 * The thread on which all views draw. The library serves one effect with one set of GL objects, so all views share one
 * context, and of the visible views the newest one with a picture draws in it.
 */
final class GlThread {
    private static Handler handler;

    // Used on the GL thread.
    static final Egl EGL = new Egl();
    private static final List<TidemarkRenderer> VISIBLE = new ArrayList<>();  // the newest last
    private static TidemarkRenderer drawing;  // one of them, or null
    private static Object owner;  // the mark of the renderer whose pictures and ink the library has; null for none
    private static boolean isLibrarySetUp;

    private GlThread() {}

    /** Starts the thread, if it does not run. Called when a view gets a window. */
    static synchronized void start(Context context) {
        if (handler != null) return;
        HandlerThread thread = new HandlerThread("Tidemark", Process.THREAD_PRIORITY_DISPLAY);
        thread.start();
        handler = new Handler(thread.getLooper());
        context.getApplicationContext().registerComponentCallbacks(new ComponentCallbacks2() {
            @Override
            public void onTrimMemory(int level) {
                if (level >= TRIM_MEMORY_BACKGROUND) post(GlThread::freeUnused);
            }

            @Override
            public void onLowMemory() {
                post(GlThread::freeUnused);
            }

            @Override
            public void onConfigurationChanged(Configuration changed) {}
        });
    }

    static void post(Runnable call) {
        handler.post(call);
    }

    /** Makes a call on the thread and returns when it is done. */
    static void await(Runnable call) {
        CountDownLatch done = new CountDownLatch(1);
        post(() -> {
            call.run();
            done.countDown();
        });
        try {
            done.await();
        } catch (InterruptedException e) {
            Thread.currentThread().interrupt();
        }
    }

    static boolean draws(TidemarkRenderer renderer) {
        return drawing == renderer;
    }

    /** Makes a renderer the newest, even if it is visible already. */
    static void show(TidemarkRenderer renderer) {
        VISIBLE.remove(renderer);
        VISIBLE.add(renderer);
        choose();
    }

    static void hide(TidemarkRenderer renderer) {
        VISIBLE.remove(renderer);
        choose();
    }

    /** Chooses the renderer that draws. Called when a renderer may have got its first picture, too. */
    static void choose() {
        TidemarkRenderer before = drawing;
        drawing = null;
        for (TidemarkRenderer renderer : VISIBLE) {
            if (renderer.hasPictures()) drawing = renderer;
        }
        if (drawing == before) return;
        if (before != null && VISIBLE.contains(before)) before.rest();
        if (drawing != null) drawing.resume();
    }

    /** Replaces the pictures and the ink of another renderer in the library. Called before each frame. */
    static void takeOver(TidemarkRenderer renderer) {
        if (owner == renderer.mark) return;
        if (isLibrarySetUp) new JniTidemarkRender().clearInkValue();  // also ends the other renderer's stroke
        renderer.renew(true);
    }

    static void hasDrawn(TidemarkRenderer renderer) {
        owner = renderer.mark;
        isLibrarySetUp = true;
    }

    /** Called when a renderer finds that the system has taken the context away, with all GL objects. */
    static void contextLost(TidemarkRenderer renderer) {
        EGL.close();
        if (owner == renderer.mark) {
            renderer.renew(false);
        } else {
            owner = null;
        }
    }

    /** Called when the renderer's view has left its window. */
    static void end(TidemarkRenderer renderer) {
        hide(renderer);
        if (owner != renderer.mark) return;
        owner = null;
        freeUnused();
    }

    // Frees the context, and the library's copies of pictures, which only other pictures replace.
    private static void freeUnused() {
        if (drawing != null) return;
        EGL.close();
        owner = null;
        if (!isLibrarySetUp) return;
        JniTidemarkRender library = new JniTidemarkRender();
        Bitmap pixel = Pictures.pixel();
        library.transferPortraitBGBitmap(pixel);
        library.transferLandscapeBGBitmap(pixel);
        library.transferWaterBitmap(pixel);
    }
}
