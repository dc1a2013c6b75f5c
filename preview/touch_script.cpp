#include "preview/touch_script.h"

#include <cerrno>
#include <charconv>
#include <cmath>
#include <cstring>
#include <fstream>
#include <sstream>
#include <string_view>

namespace {

// Longest time and farthest position that a script may name: an hour, and what an int holds with room to spare.
constexpr std::int64_t kLongestTimeMs = 3600 * 1000;
constexpr double kFarthest = 1.0e6;

template <class Number>
bool parseNumber(std::string_view text, Number& value) {
    const auto [end, problem] = std::from_chars(text.data(), text.data() + text.size(), value);
    return problem == std::errc() && end == text.data() + text.size();
}

bool parseAction(const std::string& text, TouchAction& action) {
    if (text == "down")
        action = TouchAction::down;
    else if (text == "move")
        action = TouchAction::move;
    else if (text == "up")
        action = TouchAction::up;
    else if (text == "cancel")
        action = TouchAction::cancel;
    else
        return false;
    return true;
}

bool parseCoordinate(std::string_view text, TouchCoordinate& coordinate) {
    coordinate.percent = text.ends_with('%');
    if (coordinate.percent) text.remove_suffix(1);
    return parseNumber(text, coordinate.value) && std::abs(coordinate.value) <= kFarthest;
}

// An empty text when the line is a good one.
std::string parseLine(std::istringstream& words, std::int64_t earliestMs, TouchEvent& event) {
    std::string time, action, x, y, pressure, rest;
    if (!(words >> time >> action >> x >> y >> pressure) || words >> rest) {
        return "expected \"time_ms action x y pressure\"";
    }
    if (!parseNumber(time, event.timeMs) || event.timeMs < 0 || event.timeMs > kLongestTimeMs) {
        return "the time \"" + time + "\" is not a number of milliseconds within an hour";
    }
    if (event.timeMs < earliestMs) {
        return "the time " + time + " is before that of the event above, " + std::to_string(earliestMs);
    }
    if (!parseAction(action, event.action)) {
        return "the action \"" + action + "\" is none of down, move, up and cancel";
    }
    for (const auto& [word, coordinate] : {std::pair{&x, &event.x}, std::pair{&y, &event.y}}) {
        if (!parseCoordinate(*word, *coordinate)) {
            return "the position \"" + *word + "\" is neither pixels nor a percentage";
        }
    }
    if (!parseNumber(pressure, event.pressure) || !(event.pressure >= 0.0f && event.pressure <= 10.0f)) {
        return "the pressure \"" + pressure + "\" is not between 0 and 10";
    }
    return "";
}

}  // namespace

int TouchCoordinate::pixels(int extent) const {
    const double exact = percent ? value * extent / 100.0 : value;
    return static_cast<int>(std::lround(exact));
}

std::optional<std::vector<TouchEvent>> parseTouchScript(
    std::istream& text, const std::string& name, std::string& error) {
    std::vector<TouchEvent> events;
    std::string line;
    for (int number = 1; std::getline(text, line); ++number) {
        std::istringstream words(line.substr(0, line.find('#')));
        if ((words >> std::ws).eof()) continue;
        TouchEvent event{};
        const std::string problem = parseLine(words, events.empty() ? 0 : events.back().timeMs, event);
        if (!problem.empty()) {
            error = name + ":" + std::to_string(number) + ": " + problem;
            return std::nullopt;
        }
        events.push_back(event);
    }
    if (text.bad()) {
        error = "cannot read the touch script " + name;
        return std::nullopt;
    }
    return events;
}

std::optional<std::vector<TouchEvent>> loadTouchScript(const std::string& path, std::string& error) {
    std::ifstream file(path);
    if (!file) {
        error = "cannot read the touch script " + path + ": " + std::strerror(errno);
        return std::nullopt;
    }
    return parseTouchScript(file, path, error);
}

void TouchPlayer::deliverBefore(double timeMs, WaterHost& host) {
    for (; next_ < events_.size() && static_cast<double>(events_[next_].timeMs) < timeMs; ++next_) {
        const TouchEvent& event = events_[next_];
        host.touch(event.action, event.x.pixels(width_), event.y.pixels(height_), event.pressure);
    }
}
