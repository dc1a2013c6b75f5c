// Hands touches to the ink in its own time. The ink tells strokes apart by the distance from one of its steps to the
// next, so it must not see how often a digitizer reports or how many reports one frame brings.
#pragma once

#include <vector>

namespace tidemark {

enum class TouchAction { down = 0, up = 1, move = 2, cancel = 3 };

struct Touch {
    TouchAction action;
    float x, y;    // pixels of the view, from its top left corner
    float weight;  // 1 for a finger
    double time;   // seconds
};

class StrokeClock {
public:
    // Reports come in the order of their times; one that comes late counts as reported with the one before it.
    void report(Touch touch);

    // The touches that the ink's step at `time` gets, in their order: each down and up reported until then, and, where
    // the finger has moved since the last step, one move to its place at that time, between the two reports around it.
    // Nothing is extrapolated: after the last report the finger rests there. A cancel ends a stroke as an up does.
    const std::vector<Touch>& step(double time);

    // Whether a finger is down, or a report still waits for its step.
    bool isActive() const { return isDown_ || !waiting_.empty(); }

    // Forgets everything.
    void reset();

private:
    std::vector<Touch> waiting_;  // not yet reached by a step
    std::vector<Touch> due_;      // of the last step
    Touch last_ = {};             // the last report that a step has reached
    Touch given_ = {};            // what the ink got last
    bool isDown_ = false;
};

}  // namespace tidemark
