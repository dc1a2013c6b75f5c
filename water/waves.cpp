#include "water/waves.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <type_traits>

#include "base/flush_denormals.h"
#include "base/groups.h"
#include "base/scratch.h"

namespace {

constexpr float kCalmSpeed = 0.009f;
constexpr float kHeightLimit = 100.0f;

template <class F>
F laplacian(const float* h, std::ptrdiff_t stride) {
    F sum = -load<F>(h) * 4.0f;
    sum += load<F>(h - stride);
    sum += load<F>(h - 1);
    sum += load<F>(h + 1);
    sum += load<F>(h + stride);
    return sum;
}

// A copy of the integrated heights of the region and its border: smoothing reads it and writes the host's array.
Scratch<float> snapshot("smoothing the water");

float magnitude(float speed) {
    return std::fabs(speed);
}

float4 magnitude(float4 speed) {
    return reinterpret_cast<float4>(reinterpret_cast<int4>(speed) & 0x7fffffff);
}

// Updates the velocities of one row. With `test` returns whether every one is within the calm band, else true.
template <bool test>
bool accelerate(
    float* velocity, const float* height, std::ptrdiff_t stride, int width, float damping, float waveSpeed) {
    // The highest speeds. A comparison with NaN keeps them.
    float4 peaks = {};
    float peak = 0.0f;
    forGroups(0, width, [=, &peak, &peaks]<class F>(F, int x) {
        const F v = (laplacian<F>(height + x, stride) * waveSpeed + load<F>(velocity + x)) * damping;
        store(v, velocity + x);
        if constexpr (!test) return;
        if constexpr (sizeof(F) == sizeof(float4)) {
            peaks = greater(magnitude(v), peaks);
        } else {
            peak = greater(magnitude(v), peak);
        }
    });
    for (int i = 0; i < 4; ++i) peak = greater(peaks[i], peak);
    return peak <= kCalmSpeed;
}

// integrated = clamp(height + velocity) for one row. `integrated` may be `height`.
void integrate(const float* height, const float* velocity, float* integrated, int width) {
    forGroups(0, width, [=](auto lanes, int x) {
        using F = decltype(lanes);
        const F high = F{} + kHeightLimit;
        const F low = F{} - kHeightLimit;
        const F t = load<F>(height + x) + load<F>(velocity + x);
        store(greater(low, lesser(high, t)), integrated + x);
    });
}

// height = k * laplacian(copy) + centre for one row; `centre` holds the heights before smoothing.
void smooth(float* height, const float* copy, const float* centre, std::ptrdiff_t copyStride, int width, float k) {
    forGroups(0, width, [=](auto lanes, int x) {
        using F = decltype(lanes);
        store(laplacian<F>(copy + x, copyStride) * k + load<F>(centre + x), height + x);
    });
}

// A region of the host's arrays.
struct Rows {
    float* velocity;  // first vertex of the region
    float* height;
    std::ptrdiff_t stride;
    int width;
    int count;
};

// Integrates and smooths rows shorter than their stride. The stride of the copy is a multiple of four floats, so that
// most loads are aligned: a load that crosses a cache line costs two.
bool integrateAndSmooth(const Rows& rows, float k) {
    const auto [v, h, stride, width, count] = rows;
    const std::ptrdiff_t copyStride = (std::ptrdiff_t{width} + 2 + 3) / 4 * 4;
    float* const copies =
        snapshot.reserve(static_cast<std::size_t>(copyStride) * (static_cast<std::size_t>(count) + 2));
    if (!copies) return false;
    float* const s = copies + copyStride;
    for (int row = 0; row < count; ++row) {
        integrate(h + row * stride, v + row * stride, s + row * copyStride, width);
    }
    const std::size_t rowBytes = static_cast<std::size_t>(width) * sizeof(float);
    std::memcpy(s - copyStride, h - stride, rowBytes);
    std::memcpy(s + count * copyStride, h + count * stride, rowBytes);
    for (int row = 0; row < count; ++row) {
        s[row * copyStride - 1] = h[row * stride - 1];
        s[row * copyStride + width] = h[row * stride + width];
    }
    for (int row = 0; row < count; ++row) {
        const float* const copy = s + row * copyStride;
        smooth(h + row * stride, copy, copy, copyStride, width, k);
    }
    return true;
}

// The same for rows that fill their stride or overlap. There the left neighbour of a row is the last vertex of the
// previous row, which this step also moves, so the copy has the layout of the array.
bool integrateAndSmoothContiguous(const Rows& rows, float k) {
    const auto [v, h, stride, width, count] = rows;
    const std::ptrdiff_t length = (count - 1) * stride + width;
    float* const copy = snapshot.reserve(static_cast<std::size_t>(length + 2 * stride));
    if (!copy) return false;
    float* const s = copy + stride;
    for (int row = 0; row < count; ++row) integrate(h + row * stride, v + row * stride, h + row * stride, width);
    std::copy_n(h - stride, length + 2 * stride, copy);
    for (int row = 0; row < count; ++row) {
        float* const heights = h + row * stride;
        smooth(heights, s + row * stride, heights, stride, width, k);
    }
    return true;
}

}  // namespace

bool stepWaves(
    float* velocity, float* height, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed) {
    if (region.yStart >= region.yEnd || region.xStart >= region.xEnd) return true;
    const int width = region.xEnd - region.xStart;
    const int rows = region.yEnd - region.yStart;

    const FlushDenormals flush;
    const std::ptrdiff_t stride = region.stride;
    const std::ptrdiff_t start = region.yStart * stride + region.xStart;
    float* const v = velocity + start;
    float* const h = height + start;

    const auto pass = [=]<bool test>(std::bool_constant<test>, int row) {
        return accelerate<test>(v + row * stride, h + row * stride, stride, width, damping, waveSpeed);
    };
    bool calm = true;
    int row = 0;
    // One row beyond the calm band decides the result; the rest skips the test.
    while (checkCalm && calm && row < rows) calm = pass(std::true_type{}, row++);
    while (row < rows) pass(std::false_type{}, row++);

    // By contract a damping of exactly 0.94f smooths more.
    const float k = damping == 0.94f ? 0.068f : 0.018f;
    const Rows all = {v, h, stride, width, rows};
    const bool isContiguous = stride > 0 && width >= stride;
    if (isContiguous ? integrateAndSmoothContiguous(all, k) : integrateAndSmooth(all, k)) return calm;
    // Without memory for the copy, integrate without smoothing.
    for (row = 0; row < rows; ++row) integrate(h + row * stride, v + row * stride, h + row * stride, width);
    return calm;
}
