#include "host/mesh_quality.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr int kFewest = 96;
constexpr int kMost = 256;  // indices have 16 bits
constexpr double kCellPixels = 6.0;

// A third of a frame of 60 Hz: the graphics processor and the app need theirs.
constexpr double kLongestWork = 1.0 / 180;
constexpr int kFramesToJudge = 20;

}  // namespace

void MeshQuality::fitTo(int width, int height, float pictureZoom) {
    const double cells = std::ceil(std::max(width, height) * double{pictureZoom} / kCellPixels);
    vertices_ = static_cast<int>(std::clamp(cells + 1.0, double{kFewest}, double{kMost}));
    frames_ = 0;
    work_ = 0.0;
}

void MeshQuality::noteWork(double seconds) {
    work_ += seconds;
    if (++frames_ < kFramesToJudge) return;
    if (work_ > kFramesToJudge * kLongestWork) vertices_ = std::max(vertices_ * 3 / 4, kFewest);
    frames_ = 0;
    work_ = 0.0;
}
