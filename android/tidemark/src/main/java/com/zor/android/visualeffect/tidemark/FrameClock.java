package com.zor.android.visualeffect.tidemark;

/** The time that each frame brings to water that moves in fixed steps. Times are those of {@code System.nanoTime}. */
final class FrameClock {
    private final double stepsPerSecond;
    private boolean running;
    private long last;

    FrameClock(int stepsPerSecond) {
        this.stepsPerSecond = stepsPerSecond;
    }

    /** Seconds that the frame which begins now brings. */
    double secondsUntil(long now) {
        double seconds = (now - last) * 1.0e-9;
        // On a display of about the water's own rate every frame brings one step: the jitter of the clock would bring
        // none to some and two to others. The first frame after a rest has no time to make up for.
        boolean aboutOneStep = Math.abs(seconds * stepsPerSecond - 1) < 0.25;
        if (!running || aboutOneStep) seconds = 1 / stepsPerSecond;
        running = true;
        last = now;
        return seconds;
    }

    /** How long to wait before the next frame. Ink moves one step a frame, so a display of 120 Hz is twice too fast. */
    long nanosToWait(long now) {
        long earliest = last + (long) (0.6e9 / stepsPerSecond);
        return running ? Math.max(0, earliest - now) : 0;
    }

    /** No time passes until the next frame. */
    void rest() {
        running = false;
    }
}
