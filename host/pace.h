// How finely the water is drawn so that it keeps the display's pace: first the mesh gets coarser, then the resolution,
// and both recover when there is room again. A late frame is also allowed fewer steps of the ink, because each costs
// the graphics processor about as much at any resolution.
#pragma once

#include <array>

namespace tidemark {

class Pace {
public:
    // Shares of the mesh's vertices and of the pixels along each side, 1 being the best.
    struct Level {
        double mesh, resolution;
        int inkSteps;  // in one frame at most
    };

    // Whether the resolution may change too; then only the mesh does.
    void allowResolution(bool allowed);

    // A frame was drawn at `now`, seconds of any steady clock, after the frame before it with nothing between them.
    // `shortest` is the least time that the host lets pass between two frames. While `keepsResolution`, that gets no
    // better. Returns whether the level has changed.
    bool frameDrawn(double now, double shortest, bool keepsResolution = false);

    // Whatever comes next says nothing of the frames before: after a rest, or a frame that did more than draw.
    void interrupt() { isFollowing_ = false; }

    Level level() const;

private:
    bool judge(double now, double shortest, bool keepsResolution);
    void setLevel(int level, double now);

    int level_ = 0;
    int lowest_ = 2;
    bool isFollowing_ = false;
    double last_ = 0.0;         // frame
    double quietUntil_ = -1.0;  // the first second, and a moment after each change, are not judged
    double rhythm_ = 1.0 / 60;  // the shortest interval that the display has shown
    std::array<double, 11> intervals_ = {};
    int count_ = 0;
    double judged_ = 0.0;    // seconds, the sum of those intervals
    double atBest_ = 0.0;    // the median interval that made level 0 too dear
    double retryAt_ = 0.0;   // when a better level is tried
    double patience_ = 8.0;  // seconds until then; doubled by each attempt that fails
};

}  // namespace tidemark
