#include "host/frame_clock.h"

double FrameClock::secondsUntil(double now) {
    const double seconds = running_ ? now - last_ : 1.0 / 60;
    running_ = true;
    last_ = now;
    return seconds;
}
