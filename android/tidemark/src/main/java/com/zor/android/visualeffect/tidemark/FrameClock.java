package com.zor.android.visualeffect.tidemark;

/** The time that each frame brings to water that moves in fixed steps. Times are seconds of any steady clock. */
final class FrameClock {
    private boolean running;
    private double last;

    /**
     * Ink moves one step a frame, so a display of 120 Hz is twice too fast: whether the frame at {@code now} is one too
     * many.
     */
    boolean isEarly(double now, int stepsPerSecond) {
        return running && now < last + 0.6 / stepsPerSecond;
    }

    /** Seconds that the frame which begins now brings. */
    double secondsUntil(double now, int stepsPerSecond) {
        double seconds = now - last;
        // On a display of about the water's own rate every frame brings one step: the jitter of the clock would bring
        // none to some and two to others. The first frame after a rest has no time to make up for.
        boolean aboutOneStep = Math.abs(seconds * stepsPerSecond - 1) < 0.25;
        if (!running || aboutOneStep) seconds = 1.0 / stepsPerSecond;
        running = true;
        last = now;
        return seconds;
    }

    /** No time passes until the next frame. */
    void rest() {
        running = false;
    }
}
