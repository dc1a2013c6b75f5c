#include "host/view_size.h"

#include <algorithm>
#include <cmath>

namespace tidemark {

namespace {

// Smallest drawn size. The display scales smaller views down.
constexpr double kShortestSide = 64.0;

// Longest drawn side: more pixels are too slow on current GPUs.
constexpr double kLongestSide = 4096.0;

}  // namespace

Size drawnSize(const ViewSize& view, Quality quality, double resolution) {
    const double most = quality == Quality::low ? 1.0 : quality == Quality::high ? 3.0 : 2.0;
    const double longer = std::max(view.width, view.height);
    const double whole = std::min(view.density, most);
    // A small view keeps its proportions: it draws all its pixels rather than sides of the smallest size.
    const double least = std::min(whole, kShortestSide / std::min(view.width, view.height));
    const double scale =
        std::min(quality == Quality::automatic ? std::max(whole * resolution, least) : whole, kLongestSide / longer);
    const auto side = [scale](double length) {
        return static_cast<int>(std::lround(std::max(length * scale, kShortestSide)));
    };
    return {side(view.width), side(view.height)};
}

}  // namespace tidemark
