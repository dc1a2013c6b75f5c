#include "water/waves.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <type_traits>

#include "base/scratch.h"
#include "tshader/flush_denormals.h"
#include "tshader/groups.h"

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

// The integrated heights of the region and of the vertices around it, so that smoothing can write the host's array
// while it still reads the neighbours' old heights.
Scratch<float> snapshot("smoothing the water");

bool isFast(float speed) {
    return std::fabs(speed) > kCalmSpeed;
}

int4 isFast(float4 speed) {
    const int4 magnitude = reinterpret_cast<int4>(speed) & 0x7fffffff;
    return reinterpret_cast<float4>(magnitude) > kCalmSpeed;
}

// Accelerates one row; with `test` returns whether all of it stays calm.
template <bool test>
bool accelerate(
    float* velocity, const float* height, std::ptrdiff_t stride, int width, float damping, float waveSpeed) {
    int4 fastLanes = {};
    bool fast = false;
    forGroups(0, width, [=, &fast, &fastLanes]<class F>(F, int x) {
        const F v = (laplacian<F>(height + x, stride) * waveSpeed + load<F>(velocity + x)) * damping;
        store(v, velocity + x);
        if constexpr (!test) return;
        if constexpr (sizeof(F) == sizeof(float4)) {
            fastLanes |= isFast(v);
        } else {
            fast |= isFast(v);
        }
    });
    return !fast && !(fastLanes[0] | fastLanes[1] | fastLanes[2] | fastLanes[3]);
}

// Writes one row of integrated heights to `integrated`, which may be the row itself.
void integrate(const float* height, const float* velocity, float* integrated, int width) {
    forGroups(0, width, [=](auto lanes, int x) {
        using F = decltype(lanes);
        const F high = F{} + kHeightLimit;
        const F low = F{} - kHeightLimit;
        const F t = load<F>(height + x) + load<F>(velocity + x);
        store(greater(low, lesser(high, t)), integrated + x);
    });
}

// Smooths one row: height <- k * laplacian(copy) + centre, where `centre` holds the heights before smoothing.
void smooth(float* height, const float* copy, const float* centre, std::ptrdiff_t copyStride, int width, float k) {
    forGroups(0, width, [=](auto lanes, int x) {
        using F = decltype(lanes);
        store(laplacian<F>(copy + x, copyStride) * k + load<F>(centre + x), height + x);
    });
}

}  // namespace

bool stepWaves(
    float* velocity, float* height, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed) {
    if (region.yStart >= region.yEnd || region.xStart >= region.xEnd) return true;
    const int width = region.xEnd - region.xStart;
    const int rows = region.yEnd - region.yStart;

    // A surface that comes to rest ends in denormals and stays there.
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
    // One row that moves settles it.
    while (checkCalm && calm && row < rows) calm = pass(std::true_type{}, row++);
    while (row < rows) pass(std::false_type{}, row++);

    // Rows that fill the stride are neighbours of each other in memory: the vertex left of a row is the last one of the
    // row before, which this step moves too. Their copies must lie as they do. Other rows are copied one by one, in
    // whole groups, so that three of the four neighbours and every store lie on the borders of groups: a load across
    // two cache lines costs two.
    const bool isContiguous = stride > 0 && width >= stride;
    const std::ptrdiff_t copyStride = isContiguous ? stride : (std::ptrdiff_t{width} + 2 + 3) / 4 * 4;
    const std::ptrdiff_t copied = copyStride * (rows + 1) + std::max<std::ptrdiff_t>(copyStride, width);
    float* const copies = snapshot.reserve(static_cast<std::size_t>(copied));
    float* const s = copies ? copies + copyStride : nullptr;
    const std::size_t rowBytes = static_cast<std::size_t>(width) * sizeof(float);
    for (row = 0; row < rows; ++row) {
        float* const heights = h + row * stride;
        float* const copy = s ? s + row * copyStride : heights;
        integrate(heights, v + row * stride, copy, width);
        if (isContiguous && s) std::memcpy(heights, copy, rowBytes);
    }
    if (!s) return calm;

    if (isContiguous) {
        const std::ptrdiff_t end = (rows - 1) * stride + width;
        std::copy_n(h - stride, stride, s - stride);
        std::copy_n(h + end, stride, s + end);
    } else {
        std::memcpy(s - copyStride, h - stride, rowBytes);
        std::memcpy(s + rows * copyStride, h + rows * stride, rowBytes);
        for (row = 0; row < rows; ++row) {
            s[row * copyStride - 1] = h[row * stride - 1];
            s[row * copyStride + width] = h[row * stride + width];
        }
    }

    // By contract exactly this damping smooths more.
    const float k = damping == 0.94f ? 0.068f : 0.018f;
    for (row = 0; row < rows; ++row) {
        float* const heights = h + row * stride;
        const float* const copy = s + row * copyStride;
        smooth(heights, copy, isContiguous ? heights : copy, copyStride, width, k);
    }
    return calm;
}
