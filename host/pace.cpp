#include "host/pace.h"

#include <algorithm>

namespace tidemark {

namespace {

constexpr Pace::Level kLevels[] = {{1.0, 1.0, 4}, {0.7, 1.0, 4},  {0.5, 1.0, 3},
                                   {0.5, 0.8, 3}, {0.5, 0.65, 2}, {0.5, 0.5, 2}};
constexpr int kMeshLevels = 3;
constexpr int kLowest = static_cast<int>(std::size(kLevels)) - 1;

// The intervals of a display that shows every frame vary by less than this factor.
constexpr double kLate = 1.4;

// Frames of this interval are not late on a faster display: full resolution is worth more than more frames. There the
// next longer interval is late, 1/45 s at 90 Hz.
constexpr double kSufficient = 1.0 / 60;
constexpr double kLateOnFast = 1.2;

// Frames that are this many times too late select the coarsest level at once.
constexpr double kFarTooLate = 3.0;

// The longest frame interval of a display, in seconds.
constexpr double kSlowestDisplay = 1.0 / 22;

// Frames are judged when they fill the list of intervals or this time, but at least kFewest of them.
constexpr double kJudgedSeconds = 0.35;
constexpr int kFewest = 3;

constexpr double kStartSeconds = 1.0;
constexpr double kSettleSeconds = 0.15;
constexpr double kMostPatience = 60.0;

}  // namespace

void Pace::allowResolution(bool allowed) {
    lowest_ = allowed ? kLowest : kMeshLevels - 1;
    level_ = std::min(level_, lowest_);
}

Pace::Level Pace::level() const {
    return kLevels[level_];
}

void Pace::setLevel(int level, double now) {
    level_ = level;
    count_ = 0;
    judged_ = 0.0;
    quietUntil_ = now + kSettleSeconds;
}

bool Pace::frameDrawn(double now, double shortest, bool keepsResolution) {
    if (quietUntil_ < 0.0) quietUntil_ = now + kStartSeconds;
    const double interval = now - last_;
    const bool follows = isFollowing_;
    isFollowing_ = true;
    last_ = now;
    if (!follows || now < quietUntil_) return false;
    intervals_[static_cast<std::size_t>(count_)] = interval;
    judged_ += interval;
    const bool isFull = ++count_ == static_cast<int>(intervals_.size());
    if (!isFull && (count_ < kFewest || judged_ < kJudgedSeconds)) return false;
    const bool hasChanged = judge(now, shortest, keepsResolution);
    count_ = 0;
    judged_ = 0.0;
    return hasChanged;
}

bool Pace::judge(double now, double shortest, bool keepsResolution) {
    // A few late frames after a pause are not a slow screen: fewer intervals count only if all of them are late.
    const bool isFull = count_ == static_cast<int>(intervals_.size());
    auto* const middle = intervals_.begin() + (isFull ? count_ / 2 : 0);
    std::nth_element(intervals_.begin(), middle, intervals_.begin() + count_);
    const double median = *middle;
    rhythm_ = std::min(rhythm_, median);
    const double late = median / std::max(std::max(rhythm_, shortest), kSufficient);
    const bool isLate = late > (rhythm_ < 0.9 * kSufficient ? kLateOnFast : kLate);
    if (isLate && level_ < lowest_) {
        if (level_ == 0) atBest_ = median;
        // An attempt at a better level has failed.
        if (now < retryAt_ + 2.0) patience_ = std::min(2 * patience_, kMostPatience);
        retryAt_ = now + patience_;
        setLevel(std::min(level_ + (late > kFarTooLate ? kLowest : late > 1.8 ? 2 : 1), lowest_), now);
        return true;
    }
    if (isLate && median > 0.9 * atBest_ && atBest_ > 0.0 && median < kSlowestDisplay) {
        // The coarsest level is not faster than the finest, so the display itself is slow.
        rhythm_ = median;
        atBest_ = 0.0;
        setLevel(0, now);
        return true;
    }
    const bool isKept = keepsResolution && level_ >= kMeshLevels;
    if (!isLate && level_ > 0 && now >= retryAt_ && !isKept) {
        retryAt_ = now;
        setLevel(level_ - 1, now);
        return true;
    }
    return false;
}

}  // namespace tidemark
