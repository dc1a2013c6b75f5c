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
 * The thread on which all views draw. The library serves one effect, with one set of GL objects, so there is one context,
 * and of the views that are shown the newest one with a picture draws in it.
 */
final class GlThread {
    private static Handler handler;

    // The rest is used on the thread only.
    static final Egl EGL = new Egl();
    private static final List<TidemarkRenderer> SHOWN = new ArrayList<>();  // the newest last
    private static TidemarkRenderer drawing;  // of these
    private static Object owner;  // the mark of whose pictures and ink the library has
    private static boolean isLibraryInUse;

    private GlThread() {}

    /** Starts the thread with the first view that is shown. */
    static synchronized void start(Context context) {
        if (handler != null) return;
        HandlerThread thread = new HandlerThread("Tidemark", Process.THREAD_PRIORITY_DISPLAY);
        thread.start();
        handler = new Handler(thread.getLooper());
        context.getApplicationContext().registerComponentCallbacks(new ComponentCallbacks2() {
            @Override
            public void onTrimMemory(int level) {
                if (level >= TRIM_MEMORY_BACKGROUND) post(GlThread::releaseUnused);
            }

            @Override
            public void onLowMemory() {
                post(GlThread::releaseUnused);
            }

            @Override
            public void onConfigurationChanged(Configuration changed) {}
        });
    }

    static void post(Runnable call) {
        handler.post(call);
    }

    /** Returns when the call is done. */
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

    /** A renderer that is shown already counts as the newest from now on. */
    static void show(TidemarkRenderer renderer) {
        SHOWN.remove(renderer);
        SHOWN.add(renderer);
        choose();
    }

    static void hide(TidemarkRenderer renderer) {
        SHOWN.remove(renderer);
        choose();
    }

    /** Again when a renderer has got its first picture. */
    static void choose() {
        TidemarkRenderer before = drawing;
        drawing = null;
        for (TidemarkRenderer renderer : SHOWN) {
            if (renderer.hasPictures()) drawing = renderer;
        }
        if (drawing == before) return;
        if (before != null && SHOWN.contains(before)) before.rest();
        if (drawing != null) drawing.goOn();
    }

    /** Before a renderer draws. What another one has left in the library is replaced. */
    static void takeOver(TidemarkRenderer renderer) {
        if (owner == renderer.mark) return;
        if (isLibraryInUse) new JniTidemarkRender().clearInkValue();  // or a stroke would go on
        renderer.renew(true);
    }

    static void hasDrawn(TidemarkRenderer renderer) {
        owner = renderer.mark;
        isLibraryInUse = true;
    }

    /** The system has taken the context from this renderer, and all that was made in it. */
    static void contextLost(TidemarkRenderer renderer) {
        EGL.close();
        if (owner == renderer.mark) {
            renderer.renew(false);
        } else {
            owner = null;
        }
    }

    /** The renderer's view is out of its window. */
    static void end(TidemarkRenderer renderer) {
        hide(renderer);
        if (owner != renderer.mark) return;
        owner = null;
        releaseUnused();
    }

    // The context, and in the library the copies of the pictures, which it keeps until it gets others.
    private static void releaseUnused() {
        if (drawing != null) return;
        EGL.close();
        owner = null;
        if (!isLibraryInUse) return;
        JniTidemarkRender library = new JniTidemarkRender();
        Bitmap pixel = Pictures.pixel();
        library.transferPortraitBGBitmap(pixel);
        library.transferLandscapeBGBitmap(pixel);
        library.transferWaterBitmap(pixel);
    }
}
