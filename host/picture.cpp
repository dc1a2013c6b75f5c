#include "host/picture.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

#include "base/float4.h"
#include "host/host_jni.h"
#include "host/native_names.h"
#include "host/shade.h"
#include "platform/desktop_bitmap.h"

namespace tidemark {

namespace {

// The source pixels along one axis that one pixel of the smaller picture covers, with their weights.
struct Span {
    int first;
    std::vector<float> shares;
};

// Divides `length` pixels, beginning with `from`, into `count` spans.
std::vector<Span> spans(double from, double length, int count) {
    constexpr double kRounding = 1e-6;  // of a pixel
    std::vector<Span> result;
    for (int i = 0; i < count; ++i) {
        const double start = from + length * i / count;
        const double end = from + length * (i + 1) / count;
        Span span = {static_cast<int>(start + kRounding), {}};
        for (int pixel = span.first; pixel < end - kRounding; ++pixel) {
            const double covered = std::min(end, pixel + 1.0) - std::max(start, static_cast<double>(pixel));
            span.shares.push_back(static_cast<float>(covered * count / length));
        }
        result.push_back(std::move(span));
    }
    return result;
}

// Sums rows first, then the columns of these sums.
Picture shrunk(const Picture& picture, const std::vector<Span>& columns, const std::vector<Span>& rows) {
    const std::size_t rowBytes = 4 * static_cast<std::size_t>(picture.width);
    Picture result = {static_cast<int>(columns.size()), static_cast<int>(rows.size()), {}};
    result.rgba.resize(4 * columns.size() * rows.size());
    std::uint8_t* out = result.rgba.data();
    std::vector<float> sum(rowBytes);
    for (const Span& row : rows) {
        std::fill(sum.begin(), sum.end(), 0.0f);
        for (std::size_t i = 0; i < row.shares.size(); ++i) {
            const std::uint8_t* const line = picture.rgba.data() + (static_cast<std::size_t>(row.first) + i) * rowBytes;
            const float share = row.shares[i];
            for (std::size_t k = 0; k < rowBytes; ++k) sum[k] += share * static_cast<float>(line[k]);
        }
        for (const Span& column : columns) {
            float4 pixel = {};
            const float* at = sum.data() + 4 * column.first;
            for (const float share : column.shares) {
                pixel += share * load<float4>(at);
                at += 4;
            }
            const int4 rounded = toInt(pixel + 0.5f);
            for (int channel = 0; channel < 4; ++channel) *out++ = static_cast<std::uint8_t>(rounded[channel]);
        }
    }
    return result;
}

Picture cropped(const Picture& picture, int left, int top, int width, int height) {
    Picture result = {width, height, {}};
    const std::size_t bytes = 4 * static_cast<std::size_t>(width);
    result.rgba.reserve(bytes * static_cast<std::size_t>(height));
    for (int row = top; row < top + height; ++row) {
        const std::uint8_t* const line = picture.rgba.data() + 4 * (std::ptrdiff_t{row} * picture.width + left);
        result.rgba.insert(result.rgba.end(), line, line + bytes);
    }
    return result;
}

float brightness(const Picture& picture) {
    double sum = 0.0;
    for (std::size_t i = 0; i < picture.rgba.size(); i += 4) {
        sum += picture.rgba[i] + picture.rgba[i + 1] + picture.rgba[i + 2];
    }
    return static_cast<float>(sum / (255.0 * 0.75 * static_cast<double>(picture.rgba.size())));
}

Picture shaded(Picture picture, PictureSlot slot, const Look& look) {
    const Shade shade = shadeOf(look, slot, brightness(picture));
    if (shade == Shade{1.0f, 1.0f, 1.0f}) return picture;
    const float factors[] = {shade.red, shade.green, shade.blue, 1.0f};
    for (std::size_t i = 0; i < picture.rgba.size(); ++i) {
        picture.rgba[i] = static_cast<std::uint8_t>(static_cast<float>(picture.rgba[i]) * factors[i % 4] + 0.5f);
    }
    return picture;
}

}  // namespace

Picture fitted(const Picture& picture, int width, int height) {
    const double scale =
        std::min(static_cast<double>(picture.width) / width, static_cast<double>(picture.height) / height);
    if (scale > 1.0) {
        return shrunk(
            picture, spans((picture.width - width * scale) / 2, width * scale, width),
            spans((picture.height - height * scale) / 2, height * scale, height));
    }
    const int columns = std::max(static_cast<int>(std::lround(width * scale)), 1);
    const int rows = std::max(static_cast<int>(std::lround(height * scale)), 1);
    return cropped(picture, (picture.width - columns) / 2, (picture.height - rows) / 2, columns, rows);
}

void handOver(PictureSlot slot, const Picture& picture) {
    DesktopBitmap bitmap;
    bitmap.info.width = static_cast<std::uint32_t>(picture.width);
    bitmap.info.height = static_cast<std::uint32_t>(picture.height);
    bitmap.info.stride = bitmap.info.width * 4;
    bitmap.info.format = ANDROID_BITMAP_FORMAT_RGBA_8888;
    bitmap.pixels = const_cast<std::uint8_t*>(picture.rgba.data());
    const auto transfer = slot == PictureSlot::portrait    ? native::transferPortraitBGBitmap
                          : slot == PictureSlot::landscape ? native::transferLandscapeBGBitmap
                                                           : native::transferWaterBitmap;
    transfer(hostEnvironment(), nullptr, &bitmap);
}

PictureSource sourceOf(const Pictures& pictures, const Look& look) {
    const auto give = [&pictures, look](PictureSlot slot, int width, int height) {
        if (slot == PictureSlot::light) return handOver(slot, shaded(pictures.light, slot, look));
        const Picture& ground = slot == PictureSlot::portrait ? pictures.portrait : pictures.landscape;
        handOver(slot, shaded(fitted(ground, width, height), slot, look));
    };
    return {give, nullptr};
}

PictureSource sourceOf(const Pictures& pictures) {
    Look plain;
    plain.wet = 0.0f;
    return sourceOf(pictures, plain);
}

}  // namespace tidemark
