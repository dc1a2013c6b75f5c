#include "host/stroke_clock.h"

#include <algorithm>

namespace tidemark {

namespace {

// Reports with a longer gap, in seconds, are separate movements: the finger rested after the first and started again
// before the second. Some digitizers report only 30 times a second.
constexpr double kLongestMovement = 0.04;

Touch between(const Touch& from, const Touch& to, double time) {
    const double start = std::max(from.time, to.time - kLongestMovement);
    if (time <= start) return from;
    const auto t = static_cast<float>((time - start) / (to.time - start));
    return {
        TouchAction::move, from.x + t * (to.x - from.x), from.y + t * (to.y - from.y),
        from.weight + t * (to.weight - from.weight), time};
}

}  // namespace

void StrokeClock::report(Touch touch) {
    if (!waiting_.empty()) touch.time = std::max(touch.time, waiting_.back().time);
    if (touch.action == TouchAction::cancel) touch.action = TouchAction::up;
    waiting_.push_back(touch);
}

const std::vector<Touch>& StrokeClock::step(double time) {
    due_.clear();
    auto next = waiting_.begin();
    for (; next != waiting_.end() && next->time <= time; ++next) {
        if (next->action != TouchAction::down && !isDown_) continue;  // before any stroke
        last_ = *next;
        if (next->action == TouchAction::move) continue;
        isDown_ = next->action == TouchAction::down;
        due_.push_back(sent_ = *next);
    }
    waiting_.erase(waiting_.begin(), next);
    if (!isDown_) return due_;
    Touch place = last_;
    if (!waiting_.empty() && waiting_.front().action != TouchAction::down) {
        place = between(last_, waiting_.front(), time);
    }
    if (place.x == sent_.x && place.y == sent_.y) return due_;
    place.action = TouchAction::move;
    due_.push_back(sent_ = place);
    return due_;
}

void StrokeClock::reset() {
    waiting_.clear();
    due_.clear();
    isDown_ = false;
}

}  // namespace tidemark
