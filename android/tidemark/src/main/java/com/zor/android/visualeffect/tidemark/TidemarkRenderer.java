package com.zor.android.visualeffect.tidemark;

import android.opengl.GLES20;
import android.opengl.GLSurfaceView;
import android.os.Handler;
import android.os.Looper;
import android.os.SystemClock;
import android.util.Log;

import org.jetbrains.annotations.NotNull;
import org.jetbrains.annotations.Nullable;

import java.util.ArrayList;
import java.util.List;
import java.util.Queue;
import java.util.concurrent.ConcurrentLinkedQueue;
import java.util.concurrent.atomic.AtomicReference;

import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.opengles.GL10;

/**
 * Draws water into a {@code GLSurfaceView} of {@code RENDERMODE_WHEN_DIRTY}, and asks for frames only while something
 * moves. {@link TidemarkView} is built on it; a surface view of your own calls {@link #show} and {@link #hide} too.
 *
 * <p>All methods but those of {@code GLSurfaceView.Renderer} may be called on any thread, whether there is a surface or
 * not: the next frame takes over what has changed.
 */
public final class TidemarkRenderer implements GLSurfaceView.Renderer {
    private interface Change {
        void apply(LiveWater water);
    }

    private interface News {
        void reach(TidemarkListener listener);
    }

    private static final String TAG = "Tidemark";

    // Seconds. With a look that lets no time pass, ink would wait for ever, and the main thread for this one.
    private static final double LONGEST_WAIT = 0.1;

    // The library serves one effect. The lock is held for every call of it, since each view has its own GL thread.
    private static final List<TidemarkRenderer> SHOWN = new ArrayList<>();  // the newest last
    private static volatile TidemarkRenderer newest;  // of these
    private static Object owner;  // the mark of whose pictures and objects the library has

    // The renderer itself would keep its view and its activity in memory.
    private final Object mark = new Object();
    private final Runnable requestRender;
    private final Queue<Change> changes = new ConcurrentLinkedQueue<>();
    private final AtomicReference<Pictures> newPictures = new AtomicReference<>();
    private volatile TidemarkListener listener;

    // Of the GL thread.
    private LiveWater water;  // null where the library does not load
    private boolean isBroken;
    private Pictures pictures;
    private int width;
    private int height;

    /**
     * With no pictures yet, without ink and rain.
     *
     * @param requestRender asks for one frame, as the method of that name of {@code GLSurfaceView} does
     */
    public TidemarkRenderer(@NotNull Runnable requestRender) {
        this.requestRender = requestRender;
    }

    /**
     * Hears on the main thread when the water is calm and what fails.
     *
     * @param listener null for nobody
     */
    public void setListener(@Nullable TidemarkListener listener) {
        this.listener = listener;
    }

    /**
     * Shows other pictures with the next frame.
     *
     * @param pictures whose bitmaps must stay unchanged while they are shown
     */
    public void setPictures(@NotNull Pictures pictures) {
        newPictures.set(pictures);
        askForFrame();
    }

    /**
     * Takes over all values; the water and the ink stay.
     *
     * @param look is copied
     */
    public void setLook(@NotNull Look look) {
        Look copy = look.clone();
        change(water -> water.setLook(copy));
    }

    /**
     * Switches the ink; it is off at first.
     *
     * @param withInk whether touches drop ink
     */
    public void setInk(boolean withInk) {
        change(water -> water.setInk(withInk));
    }

    /** Lets all ink vanish. */
    public void clearInk() {
        change(LiveWater::clearInk);
    }

    /**
     * Switches the rain; it is off at first.
     *
     * @param falling whether it rains
     */
    public void setRain(boolean falling) {
        change(water -> water.setRain(falling));
    }

    /**
     * One touch event. While another renderer draws, or none, it only ends what began before.
     *
     * @param action as in {@code MotionEvent}: 0 down, 1 up, 2 move, 3 cancel
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param pressure around 1
     */
    public void touch(int action, int x, int y, float pressure) {
        boolean isEnd = action == WaterHost.UP || action == WaterHost.CANCEL;
        if (isEnd || newest == this) change(water -> water.touch(action, x, y, pressure));
    }

    /**
     * A splash without a finger; it drops no ink. Nothing while another renderer draws, or none.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param strength 1 for that of a finger that comes down
     */
    public void ripple(int x, int y, float strength) {
        if (newest == this) change(water -> water.splash(x, y, strength));
    }

    /** From now on this renderer draws, and others rest until it hides. */
    public void show() {
        synchronized (SHOWN) {
            SHOWN.remove(this);
            if (!SHOWN.isEmpty()) Log.w(TAG, "one view at a time: the older one rests while a newer one is shown");
            SHOWN.add(this);
            newest = this;
        }
        requestRender.run();
    }

    /** Asks for no more frames, and lets the one that was shown before go on. */
    public void hide() {
        synchronized (SHOWN) {
            SHOWN.remove(this);
            if (newest != this) return;
            newest = SHOWN.isEmpty() ? null : SHOWN.get(SHOWN.size() - 1);
            if (newest != null) newest.requestRender.run();
        }
    }

    /** Also after the context was lost. */
    @Override
    public void onSurfaceCreated(GL10 gl, EGLConfig config) {
        if (isReady()) water.renewContext();
    }

    /** A surface of the same size in the same context keeps water and ink, as after a pause. */
    @Override
    public void onSurfaceChanged(GL10 gl, int width, int height) {
        if (!isReady() || width == this.width && height == this.height) return;
        this.width = width;
        this.height = height;
        water.resize(width, height);
    }

    @Override
    public void onDrawFrame(GL10 gl) {
        double start = seconds();
        LiveWater.Frame frame;
        while ((frame = tryFrame()) == LiveWater.Frame.WAITING && seconds() < start + LONGEST_WAIT) {
            SystemClock.sleep(1);
        }
        if (frame != LiveWater.Frame.DRAWN) GLES20.glClear(GLES20.GL_COLOR_BUFFER_BIT);  // nothing to show
    }

    void report(TidemarkListener.Failure failure, String message) {
        Log.e(TAG, message);
        tell(heard -> heard.onFailure(failure, message));
    }

    private void change(Change change) {
        changes.add(change);
        askForFrame();
    }

    // One that rests would have to clear its surface, and shows its last picture as long as nobody asks.
    private void askForFrame() {
        if (newest == this) requestRender.run();
    }

    private LiveWater.Frame tryFrame() {
        synchronized (SHOWN) {
            // What was asked for before a newer one came can still be drawn until that one does.
            if (newest != this && owner != mark || !isReady()) return LiveWater.Frame.RESTING;
            if (owner != mark) takeOver();
            takeChanges();
            // The surface shows its buffer after every call, so every call has to fill it.
            water.redraw();
            double start = seconds();
            LiveWater.Frame frame = water.frame(start);
            if (frame == LiveWater.Frame.DRAWN) {
                water.noteWork(seconds() - start);
                if (!water.isResting()) {
                    askForFrame();
                } else {
                    tell(TidemarkListener::onCalm);
                }
            }
            return frame;
        }
    }

    private static double seconds() {
        return SystemClock.elapsedRealtimeNanos() * 1.0e-9;
    }

    // Loads the library, which the layout editor and an app's tests on a desktop do not have.
    private boolean isReady() {
        if (water != null || isBroken) return water != null;
        try {
            water = new LiveWater(new JniTidemarkRender(), new Look(), (int) System.nanoTime());
        } catch (LinkageError e) {
            isBroken = true;
            report(TidemarkListener.Failure.NO_LIBRARY, e.toString());
        }
        return water != null;
    }

    // The library may have another renderer's pictures, a stroke of its finger, and objects of its context.
    private void takeOver() {
        if (owner != null) {
            new JniTidemarkRender().clearInkValue();
            water.renewContext();
            if (pictures != null) water.setPictures(pictures = pictures.asNew());
        }
        owner = mark;
    }

    private void takeChanges() {
        Pictures handedIn = newPictures.getAndSet(null);
        if (handedIn != null) takePictures(handedIn);
        for (Change change; (change = changes.poll()) != null;) change.apply(water);
    }

    private void takePictures(Pictures handedIn) {
        int[] most = new int[1];
        GLES20.glGetIntegerv(GLES20.GL_MAX_TEXTURE_SIZE, most, 0);
        if (handedIn.longestSide() > most[0]) {
            report(TidemarkListener.Failure.PICTURE_TOO_LARGE, "a picture has a side of " + handedIn.longestSide()
                    + " pixels, and the largest texture of the device one of " + most[0]);
            return;
        }
        pictures = handedIn;
        water.setPictures(handedIn);
    }

    // A listener that was taken away meanwhile hears nothing.
    private void tell(News news) {
        if (listener == null) return;
        new Handler(Looper.getMainLooper()).post(() -> {
            TidemarkListener heard = listener;
            if (heard != null) news.reach(heard);
        });
    }
}
