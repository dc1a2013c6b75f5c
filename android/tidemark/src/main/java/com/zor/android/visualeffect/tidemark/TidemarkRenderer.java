package com.zor.android.visualeffect.tidemark;

import android.opengl.GLES20;
import android.opengl.GLSurfaceView;
import android.os.Handler;
import android.os.Looper;
import android.util.Log;
import android.view.MotionEvent;

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
    /** Gives the surface another size, on the main thread. */
    interface Surface {
        void setSize(int width, int height);
    }

    private interface Change {
        void apply(NativeWater water);
    }

    private interface News {
        void reach(TidemarkListener listener);
    }

    private static final String TAG = "Tidemark";

    // The library serves one effect. The lock is held for every call of it, since each view has its own GL thread.
    private static final List<TidemarkRenderer> SHOWN = new ArrayList<>();  // the newest last
    private static volatile TidemarkRenderer newest;  // of these
    private static Object owner;  // the mark of whose pictures and objects the library has

    // The renderer itself would keep its view and its activity in memory.
    private final Object mark = new Object();
    private final FrameTimer timer;
    private final Surface surface;
    private final Queue<Change> changes = new ConcurrentLinkedQueue<>();
    private final AtomicReference<Pictures> newPictures = new AtomicReference<>();
    private volatile TidemarkListener listener;
    private volatile boolean hasView;  // or all that is known is the surface

    // Of the GL thread.
    private NativeWater water;  // null where the library does not load
    private boolean isBroken;
    private int width;  // of the surface, pixels
    private int height;
    private Quality quality = Quality.AUTO;

    /**
     * With no pictures yet, without ink and rain.
     *
     * @param requestRender asks for one frame, as the method of that name of {@code GLSurfaceView} does
     */
    public TidemarkRenderer(@NotNull Runnable requestRender) {
        this(requestRender, (width, height) -> {});
    }

    TidemarkRenderer(Runnable requestRender, Surface surface) {
        timer = new FrameTimer(requestRender);
        this.surface = surface;
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
     * @throws IllegalArgumentException naming a value that is beyond its limits; nothing changes
     */
    public void setLook(@NotNull Look look) {
        Look copy = look.clone();
        copy.forEach(Look::checked);
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
        change(NativeWater::clearInk);
    }

    /**
     * Switches the rain; it is off at first.
     *
     * @param falling whether it rains
     */
    public void setRain(boolean falling) {
        change(water -> water.setRain(falling));
    }

    void setQuality(Quality quality) {
        change(water -> {
            this.quality = quality;
            if (hasView) water.setQuality(quality.ordinal());
        });
    }

    /** Sides in density-independent pixels; from now on the surface has the size that the quality asks for. */
    void setView(double width, double height, double density) {
        hasView = true;
        double now = FrameTimer.now();
        change(water -> {
            water.setQuality(quality.ordinal());
            water.setView(width, height, density, now);
        });
    }

    /**
     * One position of a touch. While another renderer draws, or none, it only ends what began before.
     *
     * @param action as in {@code MotionEvent}: 0 down, 1 up, 2 move, 3 cancel
     * @param x share of the view's width from its left edge
     * @param y share of its height from its top edge
     * @param isStylus whether the pressure counts
     * @param pressure as {@code MotionEvent} has it
     * @param time of the event, likewise
     */
    public void touch(int action, float x, float y, boolean isStylus, float pressure, long time) {
        boolean isEnd = action == MotionEvent.ACTION_UP || action == MotionEvent.ACTION_CANCEL;
        if (!isEnd && newest != this) return;
        change(water -> water.touch(action, x, y, isStylus, pressure, time * FrameTimer.MILLISECOND));
    }

    /**
     * A splash without a finger; it drops no ink. Nothing while another renderer draws, or none.
     *
     * @param x share of the view's width from its left edge
     * @param y share of its height from its top edge
     * @param strength 1 for that of a finger that comes down
     */
    public void ripple(float x, float y, float strength) {
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
        timer.askForFrame();
    }

    /** Asks for no more frames, and lets the one that was shown before go on. */
    public void hide() {
        synchronized (SHOWN) {
            SHOWN.remove(this);
            timer.stop();
            if (newest != this) return;
            newest = SHOWN.isEmpty() ? null : SHOWN.get(SHOWN.size() - 1);
            if (newest != null) newest.timer.askForFrame();
        }
    }

    /** Also after the context was lost. */
    @Override
    public void onSurfaceCreated(GL10 gl, EGLConfig config) {
        if (isReady()) water.renewContext();
    }

    @Override
    public void onSurfaceChanged(GL10 gl, int width, int height) {
        this.width = width;
        this.height = height;
        if (!isReady()) return;
        if (!hasView) {
            water.setQuality(Quality.HIGH.ordinal());  // which stays the same
            water.setView(width, height, 1, FrameTimer.now());
        }
        if (!hasView || water.width() == width && water.height() == height) water.resized();
    }

    @Override
    public void onDrawFrame(GL10 gl) {
        synchronized (SHOWN) {
            if (!draw(timer.takeTime())) GLES20.glClear(GLES20.GL_COLOR_BUFFER_BIT);  // nothing to show
        }
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
        if (newest == this) timer.askForFrame();
    }

    private boolean draw(double now) {
        // What was asked for before a newer one came can still be drawn until that one does.
        if (newest != this && owner != mark || !isReady()) return false;
        if (owner != mark) takeOver();
        takeChanges();
        // The surface shows its buffer after every call, so every call has to fill it.
        water.redraw();
        int frame = water.frame(now);
        if (frame == NativeWater.RESIZE) {
            resize();
            frame = water.frame(now);
        }
        double due = water.due();
        if (newest == this) timer.setDue(due);
        if (frame == NativeWater.DRAWN && due == FrameTimer.NEVER) tell(TidemarkListener::onCalm);
        return frame == NativeWater.DRAWN;
    }

    private void resize() {
        int wantedWidth = water.width();
        int wantedHeight = water.height();
        if (wantedWidth == width && wantedHeight == height) {
            water.resized();
        } else {
            new Handler(Looper.getMainLooper()).post(() -> surface.setSize(wantedWidth, wantedHeight));
        }
    }

    // Loads the library, which the layout editor and an app's tests on a desktop do not have.
    private boolean isReady() {
        if (water != null || isBroken) return water != null;
        try {
            water = new NativeWater((int) System.nanoTime());
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
            water.renewPictures();
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
        if (handedIn.longestSideOfLight() <= most[0]) {
            water.setPictures(handedIn);
        } else {
            report(TidemarkListener.Failure.PICTURE_TOO_LARGE, "the light has a side of " + handedIn.longestSideOfLight()
                    + " pixels, and the largest texture of the device one of " + most[0]);
        }
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
