package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;
import android.graphics.SurfaceTexture;
import android.opengl.EGLSurface;
import android.opengl.GLES20;
import android.os.Handler;
import android.os.Looper;
import android.os.SystemClock;
import android.util.Log;
import android.view.Choreographer;
import android.view.MotionEvent;

import java.nio.ByteBuffer;

/**
 * The part of a view that is on {@link GlThread}: draws its water into its window with the display's refresh, and asks for
 * no frames while nothing moves. Times are seconds of {@code System.nanoTime}, which is the clock of touches as well.
 */
final class TidemarkRenderer implements Choreographer.FrameCallback {
    /** The state of the water. */
    enum State { NOT_READY, MOVING, CALM, RESTING }

    /** The view; called on the main thread. */
    interface View {
        void becomes(State state);

        void fails(TidemarkListener.Failure failure, String message);

        /** Asks for a surface of so many pixels, of which the renderer then hears by {@link #setWindow}. */
        void setSurfaceSize(int width, int height);
    }

    interface Change {
        void apply(NativeWater water);
    }

    static final double MILLISECOND = 1e-3;
    private static final double NEVER = Double.POSITIVE_INFINITY;
    private static final String TAG = "Tidemark";

    /** Stands for this renderer where it must not be kept in memory, and its view with it. */
    final Object mark = new Object();

    private final Handler main = new Handler(Looper.getMainLooper());
    private final View view;
    private boolean isStarted;  // of the main thread

    private NativeWater water;  // null where the library does not load
    private boolean isBroken;
    private Object window;  // a Surface or a SurfaceTexture; null while the view is not shown
    private EGLSurface surface;  // of the window
    private int width;  // of the surface, pixels
    private int height;
    private State state = State.NOT_READY;
    private boolean isPaused;
    private boolean isStale;  // a frame is due in spite of the pause
    private double lastFrame;
    private boolean isAwaited;  // the next refresh
    private CodeStroke stroke;

    TidemarkRenderer(View view) {
        this.view = view;
    }

    // Called on the main thread.

    /** Changes from before the view is first shown are in the {@link Choices} that it then hands over. */
    void change(Change change) {
        if (isStarted) {
            GlThread.post(() -> {
                if (water == null) return;
                change.apply(water);
                isStale = true;
                GlThread.choose();
                schedule();
            });
        }
    }

    /**
     * Shows the water in this window from now on, or nowhere. When it returns, the former window is no longer used.
     *
     * @param choices are taken over with the first window
     */
    void setWindow(Object window, int width, int height, Choices choices) {
        if (window == null && !isStarted) return;
        isStarted = true;
        Choices now = choices.clone();
        if (window == null) {
            GlThread.await(() -> open(null, 0, 0, now));
        } else {
            GlThread.post(() -> open(window, width, height, now));
        }
    }

    /** The view is out of its window: what was made for it is freed, unless another view draws. */
    void end() {
        if (isStarted) GlThread.await(() -> GlThread.end(this));
    }

    /** One position of a touch, as shares of the view's sides. While another view draws, it only ends what began before. */
    void touch(int action, float x, float y, boolean isStylus, float pressure, long time) {
        boolean isEnd = action == MotionEvent.ACTION_UP || action == MotionEvent.ACTION_CANCEL;
        change(water -> {
            if (isEnd || GlThread.draws(this)) water.touch(action, x, y, isStylus, pressure, time * MILLISECOND);
        });
    }

    /** A drop that falls before the first frame is seen in it. One that falls while the view is away is forgotten. */
    void drop(float x, float y, float strength, boolean withInk) {
        change(water -> {
            if (state == State.NOT_READY || GlThread.draws(this)) water.splash(x, y, strength, withInk);
        });
    }

    void stroke(float[] shares, double seconds) {
        change(water -> {
            if (GlThread.draws(this)) stroke = new CodeStroke(shares, now(), seconds);
        });
    }

    void setPaused(boolean paused) {
        change(water -> isPaused = paused);
    }

    /** Waits for a frame. Null where the view does not draw. */
    Bitmap toBitmap() {
        Bitmap[] result = new Bitmap[1];
        if (isStarted) GlThread.await(() -> result[0] = read());
        return result[0];
    }

    static double now() {
        return SystemClock.uptimeMillis() * MILLISECOND;
    }

    // Called on the GL thread.

    boolean hasPictures() {
        return water != null && water.hasPictures();
    }

    /** The library has none of what it had for this water: in the context nothing, and perhaps other pictures. */
    void renew(boolean withPictures) {
        water.renewContext();
        if (withPictures) water.renewPictures();
    }

    /** Another view draws. */
    void rest() {
        stroke = null;
        become(State.RESTING);
    }

    /** No other view draws any more. */
    void goOn() {
        water.redraw();
        isStale = true;
        schedule();
    }

    /** Awaits a refresh of the display where one will bring something new. */
    void schedule() {
        if (isAwaited || !canDraw()) return;
        if (isPaused ? !isStale : water.due() == NEVER && stroke == null) return;
        isAwaited = true;
        Choreographer.getInstance().postFrameCallback(this);
    }

    @Override
    public void doFrame(long nanoTime) {
        isAwaited = false;
        if (!canDraw()) return;
        double now = isPaused && lastFrame > 0 ? lastFrame : nanoTime * 1e-9;
        if (stroke != null && !isPaused && !stroke.follow(water, now)) stroke = null;
        if (isPaused ? isStale : now >= water.due()) draw(now, null);
        schedule();
    }

    private boolean canDraw() {
        return window != null && GlThread.draws(this);
    }

    private void open(Object newWindow, int width, int height, Choices choices) {
        if (newWindow != window || width != this.width || height != this.height) closeSurface();
        window = newWindow;
        this.width = width;
        this.height = height;
        if (window == null || !isReady(choices)) {
            GlThread.hide(this);
            return;
        }
        boolean isFixed = !choices.hasView();
        if (isFixed) {
            water.setQuality(Quality.HIGH.ordinal());  // which leaves the size as it is
            water.setView(width, height, 1, now());
        }
        if (isFixed || water.width() == width && water.height() == height) water.resized();
        water.redraw();
        isStale = true;
        GlThread.show(this);
        schedule();
    }

    // Loads the library, which the layout editor and an app's tests on a desktop do not have.
    private boolean isReady(Choices choices) {
        if (water != null || isBroken) return water != null;
        try {
            water = new NativeWater((int) System.nanoTime(), message -> fail(TidemarkListener.Failure.PICTURE, message));
            choices.applyTo(water);
            isPaused = choices.isPaused;
        } catch (LinkageError e) {
            isBroken = true;
            fail(TidemarkListener.Failure.NO_LIBRARY, e.toString());
        }
        return water != null;
    }

    private boolean draw(double now, ByteBuffer pixels) {
        isStale = false;
        if (!makeCurrent()) return false;
        GlThread.takeOver(this);
        int frame = water.frame(now);
        if (frame == NativeWater.RESIZE) {
            resize();
            frame = water.frame(now);
        }
        if (frame != NativeWater.DRAWN) return false;
        if (pixels != null) GLES20.glReadPixels(0, 0, width, height, GLES20.GL_RGBA, GLES20.GL_UNSIGNED_BYTE, pixels);
        GlThread.hasDrawn(this);
        lastFrame = now;
        boolean isShown = GlThread.EGL.show(surface);
        if (isShown) {
            become(water.due() == NEVER ? State.CALM : State.MOVING);
        } else {
            surfaceLost();
        }
        return isShown;
    }

    private boolean makeCurrent() {
        if (!GlThread.EGL.open()) {
            isBroken = true;
            window = null;
            fail(TidemarkListener.Failure.NO_OPENGL, "this device has no OpenGL ES 2.0");
            return false;
        }
        boolean isNew = surface == null;
        if (isNew) surface = GlThread.EGL.surfaceOf(window);
        if (surface == null || !GlThread.EGL.makeCurrent(surface)) {
            surfaceLost();
            return false;
        }
        // The main thread consumes the frames of a texture, and may be waiting for this thread.
        if (isNew && window instanceof SurfaceTexture) GlThread.EGL.waitForNobody();
        return true;
    }

    private void surfaceLost() {
        if (GlThread.EGL.isContextLost()) {
            GlThread.contextLost(this);
            isStale = true;
        } else {
            window = null;  // the system is about to take it away, or to give another
        }
        closeSurface();
    }

    private void closeSurface() {
        if (surface != null) GlThread.EGL.destroy(surface);
        surface = null;
    }

    private void resize() {
        int wantedWidth = water.width();
        int wantedHeight = water.height();
        if (wantedWidth == width && wantedHeight == height) {
            water.resized();
        } else {
            main.post(() -> view.setSurfaceSize(wantedWidth, wantedHeight));
        }
    }

    private Bitmap read() {
        if (!canDraw() || state == State.NOT_READY) return null;
        ByteBuffer pixels = ByteBuffer.allocateDirect(4 * width * height);
        water.redraw();
        return draw(lastFrame, pixels) ? Pictures.upright(pixels, width, height) : null;
    }

    private void become(State next) {
        if (next == state) return;
        state = next;
        main.post(() -> view.becomes(next));
    }

    private void fail(TidemarkListener.Failure failure, String message) {
        Log.e(TAG, message);
        main.post(() -> view.fails(failure, message));
    }
}
