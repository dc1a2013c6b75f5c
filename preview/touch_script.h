// Touch scripts: plain text, one event per line, "time_ms action x y pressure".
//
//     # a finger goes down in the middle and is lifted again
//     0    down  50%  50%  1.0
//     100  up    50%  50%  1.0
//
// Times never decrease. Actions are down, move, up and cancel. Positions are relative to the top left of the view, in
// pixels or, with %, in per cent of its width and height. # starts a comment.
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

// On failure both return nothing and store the reason in `error`, one line that begins with "name:line: ".
std::optional<std::vector<TouchEvent>> parseTouchScript(
    std::istream& text, const std::string& name, std::string& error);
std::optional<std::vector<TouchEvent>> loadTouchScript(const std::string& path, std::string& error);

// Formats a script, with positions rounded to thousandths.
std::string writeTouchScript(const std::vector<TouchEvent>& events);

// Plays a script.
class TouchPlayer {
public:
    TouchPlayer(std::vector<TouchEvent> events, int width, int height)
        : events_(std::move(events)), width_(width), height_(height) {}

    // Sends the events before `timeMs` that have not been sent yet.
    void deliverBefore(double timeMs, WaterHost& host);

private:
    std::vector<TouchEvent> events_;
    int width_, height_;
    std::size_t next_ = 0;
};

}  // namespace tidemark
