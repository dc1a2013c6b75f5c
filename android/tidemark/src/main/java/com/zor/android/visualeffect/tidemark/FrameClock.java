package com.zor.android.visualeffect.tidemark;

/** The time that each frame brings. Times are seconds of any steady clock. */
final class FrameClock {
    private boolean running;
    private double last;

    /**
     * Seconds that the frame which begins now brings; after a rest those of one frame at 60 Hz, as there is nothing to
     * make up for.
     */
    double secondsUntil(double now) {
        double seconds = running ? now - last : 1.0 / 60;
        running = true;
        last = now;
        return seconds;
    }

    /** No time passes until the next frame. */
    void rest() {
        running = false;
    }
}
