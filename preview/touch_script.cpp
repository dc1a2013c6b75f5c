#include "preview/touch_script.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <cstdio>
#include <sstream>
#include <string_view>
#include <utility>

#include "host/quoted.h"
#include "host/read_file.h"

namespace tidemark {

namespace {

// Limits of a script: an hour, and positions that fit an int.
constexpr std::int64_t kLongestTimeMs = 3600 * 1000;
constexpr double kFarthest = 1.0e6;

// More than an hour of moves at 120 Hz.
constexpr std::size_t kMostBytes = 16 << 20;

template <class Number>
std::optional<Number> parseNumber(std::string_view text) {
    Number value{};
    const auto [end, problem] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (problem != std::errc() || end != text.data() + text.size()) return std::nullopt;
    return value;
}

constexpr std::pair<std::string_view, TouchAction> kActions[] = {
    {"down", TouchAction::down}, {"move", TouchAction::move}, {"up", TouchAction::up}, {"cancel", TouchAction::cancel}};

std::optional<TouchAction> parseAction(std::string_view text) {
    for (const auto& [name, action] : kActions) {
        if (name == text) return action;
    }
    return std::nullopt;
}

std::optional<TouchCoordinate> parseCoordinate(std::string_view text) {
    const bool percent = text.ends_with('%');
    if (percent) text.remove_suffix(1);
    const std::optional<double> value = parseNumber<double>(text);
    if (!value || !(std::abs(*value) <= kFarthest)) return std::nullopt;
    return TouchCoordinate{*value, percent};
}

std::optional<TouchEvent> parseLine(std::istringstream& words, std::int64_t earliestMs, std::string& error) {
    const auto fail = [&](const std::string& reason) {
        error = reason;
        return std::nullopt;
    };
    std::string time, action, x, y, pressure, rest;
    if (!(words >> time >> action >> x >> y >> pressure) || words >> rest) {
        return fail("expected \"time_ms action x y pressure\"");
    }
    const auto timeMs = parseNumber<std::int64_t>(time);
    if (!timeMs || *timeMs < 0 || *timeMs > kLongestTimeMs) {
        return fail("the time " + quoted(time) + " is not a number of milliseconds within an hour");
    }
    if (*timeMs < earliestMs) {
        return fail(
            "the time " + std::to_string(*timeMs) + " is before that of the event above, " +
            std::to_string(earliestMs));
    }
    const auto parsedAction = parseAction(action);
    if (!parsedAction) return fail("the action " + quoted(action) + " is none of down, move, up and cancel");
    const auto parsedX = parseCoordinate(x);
    const auto parsedY = parseCoordinate(y);
    if (!parsedX || !parsedY) {
        return fail("the position " + quoted(parsedX ? y : x) + " is neither pixels nor a percentage");
    }
    const auto parsedPressure = parseNumber<float>(pressure);
    if (!parsedPressure || !(*parsedPressure >= 0.0f && *parsedPressure <= 10.0f)) {
        return fail("the pressure " + quoted(pressure) + " is not between 0 and 10");
    }
    return TouchEvent{*timeMs, *parsedAction, *parsedX, *parsedY, *parsedPressure};
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
        const std::optional<TouchEvent> event = parseLine(words, events.empty() ? 0 : events.back().timeMs, error);
        if (!event) {
            error = name + ":" + std::to_string(number) + ": " + error;
            return std::nullopt;
        }
        events.push_back(*event);
    }
    return events;
}

std::optional<std::vector<TouchEvent>> loadTouchScript(const std::string& path, std::string& error) {
    const std::optional<std::string> content = readFile(path, "the touch script", kMostBytes, error);
    if (!content) return std::nullopt;
    std::istringstream text(*content);
    return parseTouchScript(text, path, error);
}

std::string writeTouchScript(const std::vector<TouchEvent>& events) {
    std::string text = "# time_ms action x y pressure\n";
    for (const TouchEvent& event : events) {
        const auto* const action = std::find_if(
            std::begin(kActions), std::end(kActions), [&](const auto& known) { return known.second == event.action; });
        char line[160];
        std::snprintf(
            line, sizeof line, "%lld %s %.3f%s %.3f%s %.2f\n", static_cast<long long>(event.timeMs),
            action->first.data(), event.x.value, event.x.percent ? "%" : "", event.y.value, event.y.percent ? "%" : "",
            static_cast<double>(event.pressure));
        text += line;
    }
    return text;
}

void TouchPlayer::deliverBefore(double timeMs, WaterHost& host) {
    for (; next_ < events_.size() && static_cast<double>(events_[next_].timeMs) < timeMs; ++next_) {
        const TouchEvent& event = events_[next_];
        host.touch(
            event.action, event.x.pixels(width_), event.y.pixels(height_), event.pressure,
            static_cast<double>(event.timeMs) / 1000.0);
    }
}

}  // namespace tidemark
