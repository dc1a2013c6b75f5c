// Resamples touches at the times of the ink's steps. The library classifies strokes by the distance between two steps,
// so that distance must not depend on the digitizer's rate or the number of reports in a frame.
#pragma once

#include <vector>

namespace tidemark {

enum class TouchAction { down = 0, up = 1, move = 2, cancel = 3 };

struct Touch {
    TouchAction action;
    float x, y;    // pixels of the view, from its top left corner
    float weight;  // 1 for a finger, otherwise relative to a finger
    double time;   // seconds
};

class StrokeClock {
public:
    // Adds a report. A report with an earlier time than the previous one gets the previous one's time.
    void report(Touch touch);

    // Returns the touches for the ink step at `time`, in order: every down and up reported until then, and, if the
    // finger has moved since the last step, one move to its position at `time`, interpolated between the reports before
    // and after. Positions are never extrapolated: after the last report the finger rests. A cancel ends a stroke as an
    // up does.
    const std::vector<Touch>& step(double time);

    // Returns whether a finger is down or a report has not reached its step yet.
    bool isActive() const { return isDown_ || !waiting_.empty(); }

    // Discards all reports and the current stroke.
    void reset();

private:
    std::vector<Touch> waiting_;  // reports after the last step
    std::vector<Touch> due_;      // result of the last step
    Touch last_ = {};             // last report up to the last step
    Touch sent_ = {};             // last touch returned by step()
    bool isDown_ = false;
};

}  // namespace tidemark
