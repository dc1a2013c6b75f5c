// The time that each frame brings. Times are seconds of any steady clock.
#pragma once

class FrameClock {
public:
    // Seconds that the frame which begins now brings; after a rest those of one frame at 60 Hz, as there is nothing to
    // make up for.
    double secondsUntil(double now);

    // No time passes until the next frame.
    void rest() { running_ = false; }

private:
    bool running_ = false;
    double last_ = 0.0;
};
