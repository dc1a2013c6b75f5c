#include "host/frame_clock.h"

#include <cmath>

bool FrameClock::isEarly(double now, int stepsPerSecond) const {
    return running_ && now < last_ + 0.6 / stepsPerSecond;
}

double FrameClock::secondsUntil(double now, int stepsPerSecond) {
    double seconds = now - last_;
    // On a display of about the water's own rate every frame brings one step: the jitter of the clock would bring none
    // to some and two to others. The first frame after a rest has no time to make up for.
    const bool aboutOneStep = std::abs(seconds * stepsPerSecond - 1.0) < 0.25;
    if (!running_ || aboutOneStep) seconds = 1.0 / stepsPerSecond;
    running_ = true;
    last_ = now;
    return seconds;
}
