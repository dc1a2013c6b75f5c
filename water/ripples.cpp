#include "water/ripples.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "base/groups.h"

namespace {

constexpr float kReach = 3.0f;

struct Range {
    int first;
    int end;
};

// Clamps, because a centre far outside the mesh gives bounds beyond the range of int.
int toIndex(float value) {
    return static_cast<int>(std::clamp(std::floor(static_cast<double>(value)), -1.0e9, 1.0e9));
}

// Returns the seven cells around `centre`, by contract without the cells 0, 1 and count - 1. A NaN fails both
// comparisons and gives the whole axis, where no cell then passes the height test.
Range boxAround(float centre, int count) {
    return {
        centre > 5.0f ? toIndex(centre - kReach) : 2,
        static_cast<float>(count - 5) > centre ? toIndex(centre + 4.0f) : count - 1};
}

}  // namespace

void addRipple(const RippleField& field, float posA, float posB, float amplitude) {
    if (field.countA < 1 || field.countB < 1) return;
    // By contract `count` cells cover the extent, not count - 1.
    const float centreA = (posA / static_cast<float>(field.extentA) + 0.5f) * static_cast<float>(field.countA);
    const float centreB = static_cast<float>(field.countB) * (0.5f + posB / static_cast<float>(field.extentB));
    const Range a = boxAround(centreA, field.countA);
    const Range b = boxAround(centreB, field.countB);
    for (int row = b.first; row < b.end; ++row) {
        float* const values = field.values + std::ptrdiff_t{row} * field.countA;
        const float offsetB = centreB - static_cast<float>(row);
        forGroups(a.first, a.end, [=](auto lanes, int column) {
            using F = decltype(lanes);
            const F offsetA = centreA - countUp<F>(column);
            const F height = kReach - squareRoot(offsetA * offsetA + offsetB * offsetB);
            const F value = load<F>(values + column);
            store(height > 0.0f ? height * amplitude + value : value, values + column);
        });
    }
}
