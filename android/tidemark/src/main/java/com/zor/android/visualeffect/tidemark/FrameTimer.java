package com.zor.android.visualeffect.tidemark;

import android.os.Handler;
import android.os.Looper;
import android.os.SystemClock;
import android.view.Choreographer;

/**
 * Asks for a frame with the display's refresh at which one is due, and for none while nothing is. Any thread may call
 * it; it works on the main thread. Times are seconds of {@code System.nanoTime}, which is the clock of touches as well.
 */
final class FrameTimer implements Choreographer.FrameCallback {
    static final double NEVER = Double.POSITIVE_INFINITY;
    static final double MILLISECOND = 1e-3;

    private final Handler main = new Handler(Looper.getMainLooper());
    private final Runnable requestRender;
    private final Runnable awaitRefresh = this::awaitRefresh;
    private volatile double due = NEVER;
    private volatile boolean isAsked;  // for a frame that nothing else makes due
    private volatile double refresh = Double.NaN;  // for which a frame is asked

    FrameTimer(Runnable requestRender) {
        this.requestRender = requestRender;
    }

    /** The next frame is due then. */
    void setDue(double time) {
        due = time;
        if (time < NEVER) main.post(awaitRefresh);
    }

    /** Something has changed: a frame shows it with the next refresh, or when it is due. */
    void askForFrame() {
        isAsked = true;
        main.post(awaitRefresh);
    }

    void stop() {
        isAsked = false;
        due = NEVER;
    }

    /**
     * The time of the frame that begins now: of the refresh, where one asked for it. The frame has to show what changed
     * before this call.
     */
    double takeTime() {
        isAsked = false;
        double asked = refresh;
        refresh = Double.NaN;
        return Double.isNaN(asked) ? now() : asked;
    }

    static double now() {
        return SystemClock.uptimeMillis() * MILLISECOND;
    }

    private void awaitRefresh() {
        Choreographer display = Choreographer.getInstance();
        display.removeFrameCallback(this);
        display.postFrameCallback(this);
    }

    @Override
    public void doFrame(long nanoTime) {
        double now = nanoTime * 1e-9;
        if (now >= due || isAsked && due == NEVER) {
            stop();
            refresh = now;
            requestRender.run();
        } else if (due < NEVER) {
            awaitRefresh();
        }
    }
}
