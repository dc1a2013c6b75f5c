// The time that each frame brings to water that moves in fixed steps. Times are seconds of any steady clock.
#pragma once

class FrameClock {
public:
    // Ink moves one step a frame, so a display of 120 Hz is twice too fast: whether the frame at `now` is one too many.
    bool isEarly(double now, int stepsPerSecond) const;

    // Seconds that the frame which begins now brings.
    double secondsUntil(double now, int stepsPerSecond);

    // No time passes until the next frame.
    void rest() { running_ = false; }

private:
    bool running_ = false;
    double last_ = 0.0;
};
