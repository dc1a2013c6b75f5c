// Chooses the level of detail at which frames keep up with the display: first the mesh becomes coarser, then the
// resolution, and both recover when there is time again. A coarser level also limits the ink's steps in a frame,
// because a step costs the graphics processor about the same at any resolution. Two steps suffice for 30 frames a
// second.
#pragma once

#include <array>

namespace tidemark {

class Pace {
public:
    // Shares of the mesh's vertices and of the pixels along each side, at most 1.
    struct Level {
        double mesh, resolution;
        int inkSteps;  // limit in one frame
    };

    // Whether the resolution may change. At first only the mesh may.
    void allowResolution(bool allowed);

    // Reports a frame at `now`, in seconds of a steady clock, that followed the previous one without a pause.
    // `shortest` is the host's minimum interval between two frames. With `keepsResolution` the resolution does not
    // rise. Returns whether the level has changed.
    bool frameDrawn(double now, double shortest, bool keepsResolution = false);

    // Ignores the interval before the next frame: call it after a rest or after a frame that did more than draw.
    void interrupt() { isFollowing_ = false; }

    Level level() const;

private:
    bool judge(double now, double shortest, bool keepsResolution);
    void setLevel(int level, double now);

    int level_ = 0;
    int lowest_ = 2;
    bool isFollowing_ = false;
    double last_ = 0.0;         // time of the last frame
    double quietUntil_ = -1.0;  // the first second and a moment after each change are ignored
    double rhythm_ = 1.0 / 60;  // the shortest interval that the display has shown
    std::array<double, 11> intervals_ = {};
    int count_ = 0;
    double judged_ = 0.0;    // seconds, the sum of those intervals
    double atBest_ = 0.0;    // the median interval at which level 0 was too slow
    double retryAt_ = 0.0;   // when a better level is tried
    double patience_ = 8.0;  // seconds until then; doubled by each attempt that fails
};

}  // namespace tidemark
