// Touch scripts: plain text, one event a line, "time_ms action x y pressure".
//
//     # a finger comes down in the middle and leaves again
//     0    down  50%  50%  1.0
//     100  up    50%  50%  1.0
//
// Times never go back. Actions are down, move, up and cancel. Positions count from the top left corner of the view,
// in pixels or, with a % sign, in hundredths of its width and height. A # starts a comment.
#pragma once

#include <cstdint>
#include <iosfwd>
#include <optional>
#include <string>
#include <vector>

#include "host/water_host.h"

namespace tidemark {

struct TouchCoordinate {
    double value;
    bool percent;

    int pixels(int extent) const;
};

struct TouchEvent {
    std::int64_t timeMs;
    TouchAction action;
    TouchCoordinate x, y;
    float pressure;
};

// On failure says why in `error`, in one line that starts with "name:line: ".
std::optional<std::vector<TouchEvent>> parseTouchScript(
    std::istream& text, const std::string& name, std::string& error);
std::optional<std::vector<TouchEvent>> loadTouchScript(const std::string& path, std::string& error);

// The lines of a script, whose parts of a pixel and of a per cent are rounded to thousandths.
std::string writeTouchScript(const std::vector<TouchEvent>& events);

// Plays a script to a host.
class TouchPlayer {
public:
    TouchPlayer(std::vector<TouchEvent> events, int width, int height)
        : events_(std::move(events)), width_(width), height_(height) {}

    // Delivers the events that are due before `timeMs` and have not been delivered yet.
    void deliverBefore(double timeMs, WaterHost& host);

private:
    std::vector<TouchEvent> events_;
    int width_, height_;
    std::size_t next_ = 0;
};

}  // namespace tidemark
