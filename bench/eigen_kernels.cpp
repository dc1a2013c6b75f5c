#include <Eigen/Core>

#include "reference/kernel_set.h"

namespace {

using Field = Eigen::Array<float, Eigen::Dynamic, Eigen::Dynamic, Eigen::RowMajor>;
using Window = Eigen::Map<Field, Eigen::Unaligned, Eigen::OuterStride<>>;

// Maps rows x columns elements that start at first + shift.
Window window(float* first, int rows, int columns, int stride, int shift = 0) {
    return {first + shift, rows, columns, Eigen::OuterStride<>(stride)};
}

bool wave(float* velocity, float* height, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed) {
    const int rows = region.yEnd - region.yStart;
    const int columns = region.xEnd - region.xStart;
    const int stride = region.stride;
    const int start = region.yStart * stride + region.xStart;
    const auto at = [=](float* field, int shift = 0) { return window(field + start, rows, columns, stride, shift); };
    Window v = at(velocity);
    Window h = at(height);
    v = ((h * -4.0f + at(height, -stride) + at(height, -1) + at(height, 1) + at(height, stride)) * waveSpeed + v) *
        damping;
    const bool calm = !checkCalm || !(v.abs() > 0.009f).any();
    h = (h + v).min(100.0f).max(-100.0f);

    static Field copy;
    copy = window(height + start - stride - 1, rows + 2, columns + 2, stride);
    const float k = damping == 0.94f ? 0.068f : 0.018f;
    h = (copy.block(1, 1, rows, columns) * -4.0f + copy.block(0, 1, rows, columns) + copy.block(1, 0, rows, columns) +
         copy.block(1, 2, rows, columns) + copy.block(2, 1, rows, columns)) *
            k +
        h;
    return calm;
}

void jacobi(JacobiTShaderImpl& kernel) {
    const int width = kernel.output.width;
    const int height = kernel.output.height;
    const auto interior = [=](const Texture<float>& t, int shift = 0) {
        return window(t.data + width + 1, height - 2, width - 2, width, shift);
    };
    window(kernel.output.data, height, width, width).setZero();
    interior(kernel.output) =
        (interior(kernel.Pressure, -1) + interior(kernel.Pressure, 1) + interior(kernel.Pressure, -width) +
         interior(kernel.Pressure, width) + kernel.Alpha * interior(kernel.Divergence)) *
        kernel.InverseBeta;
}

}  // namespace

const KernelSet kEigen = {
    .name = "eigen",
    .wave = wave,
    .jacobi = jacobi,
    .ripple = nullptr,
    .advection = nullptr,
    .forcing = nullptr,
    .divergence = nullptr,
    .gradient = nullptr,
    .packing = nullptr};
