package com.zor.android.visualeffect.tidemark;

import android.content.Context;
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
 * The part of a view that runs on {@link GlThread}. It draws the water into the view's window with the display's
 * refresh, and requests no refresh while nothing moves. Times are seconds of the system's uptime, the clock of touches.
 */
final class TidemarkRenderer implements Choreographer.FrameCallback {
    /** The state of the water. */
    enum State {
        /** No frame was drawn yet. */
        NOT_READY,
        MOVING,
        CALM,
        /** Another view draws. */
        RESTING
    }

    /** Called on the main thread. */
    interface Listener {
        void stateChanged(State state);

        void failed(TidemarkListener.Failure failure, String message);

        /** The surface shall have this size in pixels; {@link #setWindow} must follow when it has. */
        void surfaceSizeWanted(int width, int height);
    }

    private interface Change {
        void apply(NativeWater water);
    }

    static final Handler MAIN = new Handler(Looper.getMainLooper());
    static final double MILLISECOND = 1e-3;
    private static final double NEVER = Double.POSITIVE_INFINITY;
    private static final String TAG = "Tidemark";

    /** Identifies this renderer for {@link GlThread}, which must not keep it and its view in memory. */
    final Object mark = new Object();

    private final Listener listener;
    private boolean isStarted;  // used on the main thread

    // Used on the GL thread.
    private NativeWater water;  // null before the first window, and if the library cannot be loaded
    private boolean isBroken;
    private Object window;  // a Surface or a SurfaceTexture; null while the view is not visible
    private EGLSurface surface;  // on the window
    private int width;  // of the surface, pixels
    private int height;
    private State state = State.NOT_READY;
    private boolean isPaused;
    private boolean isStale;  // a frame must be drawn even in a pause
    private double lastFrame;  // its time
    private boolean isRefreshRequested;
    private CodeStroke stroke;  // null if none is being drawn

    TidemarkRenderer(Listener listener) {
        this.listener = listener;
    }

    // Called on the main thread.

    /** Whether there was a window. Before, all methods but {@link #setWindow} do nothing. */
    boolean isStarted() {
        return isStarted;
    }

    private void change(Change change) {
        if (!isStarted) return;
        GlThread.post(() -> {
            if (water == null) return;
            change.apply(water);
            isStale = true;
            GlThread.choose();
            schedule();
        });
    }

    /**
     * Draws into a window from now on. When the method returns, the previous window is no longer used.
     *
     * @param window null for none
     */
    void setWindow(Context context, Object window, int width, int height, WaterSettings settings) {
        if (window == null) {
            if (isStarted) GlThread.await(this::close);
            return;
        }
        isStarted = true;
        GlThread.start(context);
        WaterSettings current = settings.clone();
        GlThread.post(() -> open(window, width, height, current));
    }

    void update(WaterSettings settings) {
        WaterSettings current = settings.clone();
        change(water -> {
            current.applyTo(water);
            isPaused = current.isPaused;
        });
    }

    /** Frees graphics memory after the view has left its window, unless another view draws. */
    void end() {
        if (isStarted) GlThread.await(() -> GlThread.end(this));
    }

    /** Passes on a position as shares of the view's sides. While another view draws, only the end of a touch counts. */
    void touch(int action, float x, float y, boolean isStylus, float pressure, double seconds) {
        boolean isEnd = action == MotionEvent.ACTION_UP || action == MotionEvent.ACTION_CANCEL;
        change(water -> {
            if (isEnd || GlThread.draws(this)) water.touch(action, x, y, isStylus, pressure, seconds);
        });
    }

    /** Makes a drop fall with the next frame, if this view draws or has not drawn yet. */
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

    void clearInk() {
        change(NativeWater::clearInk);
    }

    /** Waits for a frame. Returns null if this view does not draw. */
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

    /** Creates the GL objects again with the next frame, and passes the pictures to the library again if necessary. */
    void renew(boolean withPictures) {
        water.renewContext();
        if (withPictures) water.renewPictures();
    }

    /** Another view draws from now on. */
    void rest() {
        stroke = null;
        setState(State.RESTING);
    }

    /** This view draws from now on. */
    void resume() {
        water.redraw();
        isStale = true;
        schedule();
    }

    /** Requests a refresh of the display if it will show something new. */
    void schedule() {
        if (isRefreshRequested || !canDraw()) return;
        if (isPaused ? !isStale : water.due() == NEVER && stroke == null) return;
        isRefreshRequested = true;
        Choreographer.getInstance().postFrameCallback(this);
    }

    @Override
    public void doFrame(long nanoTime) {
        isRefreshRequested = false;
        if (!canDraw()) return;
        double now = isPaused && lastFrame > 0 ? lastFrame : nanoTime * 1e-9;
        if (stroke != null && !isPaused && !stroke.follow(water, now)) stroke = null;
        if (isPaused ? isStale : now >= water.due()) draw(now, null);
        schedule();
    }

    private boolean canDraw() {
        return window != null && GlThread.draws(this);
    }

    private void open(Object newWindow, int width, int height, WaterSettings settings) {
        if (newWindow != window || width != this.width || height != this.height) closeSurface();
        window = newWindow;
        this.width = width;
        this.height = height;
        if (!createWater()) return;
        boolean isFixed = !settings.hasView();
        if (isFixed) {
            settings.quality = Quality.HIGH;  // does not reduce the size
            settings.setView(width, height, 1);
        }
        settings.applyTo(water);
        isPaused = settings.isPaused;
        if (isFixed || water.width() == width && water.height() == height) water.resized();
        water.redraw();
        isStale = true;
        GlThread.show(this);
        schedule();
    }

    private void close() {
        closeSurface();
        window = null;
        GlThread.hide(this);
    }

    // Loads the library, which does not exist in a layout editor and in an app's tests on a desktop.
    private boolean createWater() {
        if (water != null || isBroken) return water != null;
        try {
            water = new NativeWater(
                    (int) System.nanoTime(), message -> fail(TidemarkListener.Failure.PICTURE, message));
        } catch (LinkageError e) {
            isBroken = true;
            fail(TidemarkListener.Failure.NO_LIBRARY, e.toString());
        }
        return water != null;
    }

    // Copies the frame to `pixels` unless that is null. Returns whether the frame was shown.
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
        boolean isShown = GlThread.EGL.swap(surface);
        if (isShown) {
            setState(water.due() == NEVER ? State.CALM : State.MOVING);
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
        if (isNew) surface = GlThread.EGL.createSurface(window);
        if (surface == null || !GlThread.EGL.makeCurrent(surface)) {
            surfaceLost();
            return false;
        }
        // The main thread takes the frames of a texture, and may be waiting for this thread.
        if (isNew && window instanceof SurfaceTexture) GlThread.EGL.swapWithoutWaiting();
        return true;
    }

    private void surfaceLost() {
        if (GlThread.EGL.isContextLost()) {
            GlThread.contextLost(this);
            isStale = true;
        } else {
            window = null;  // the system will call with another one, or with none
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
            MAIN.post(() -> listener.surfaceSizeWanted(wantedWidth, wantedHeight));
        }
    }

    private Bitmap read() {
        if (!canDraw() || state == State.NOT_READY) return null;
        ByteBuffer pixels = ByteBuffer.allocateDirect(4 * width * height);
        water.redraw();
        return draw(lastFrame, pixels) ? Pictures.upright(pixels, width, height) : null;
    }

    private void setState(State next) {
        if (next == state) return;
        state = next;
        MAIN.post(() -> listener.stateChanged(next));
    }

    private void fail(TidemarkListener.Failure failure, String message) {
        Log.e(TAG, message);
        MAIN.post(() -> listener.failed(failure, message));
    }
}
