// A picture in linear light, on which the painters draw.
#pragma once

#include <algorithm>
#include <cstddef>
#include <vector>

#include "host/picture.h"

namespace tidemark {

struct Rgb {
    float r, g, b;  // linear light, 1 is white
};

inline Rgb mix(Rgb a, Rgb b, float t) {
    return {a.r + (b.r - a.r) * t, a.g + (b.g - a.g) * t, a.b + (b.b - a.b) * t};
}

inline Rgb operator*(Rgb colour, float light) {
    return {colour.r * light, colour.g * light, colour.b * light};
}

// Rows from the top.
struct Canvas {
    Canvas(int w, int h) : width(w), height(h), pixels(static_cast<std::size_t>(w) * static_cast<std::size_t>(h)) {}

    Rgb& at(int column, int row) {
        return pixels
            [static_cast<std::size_t>(row) * static_cast<std::size_t>(width) + static_cast<std::size_t>(column)];
    }

    int width, height;
    std::vector<Rgb> pixels;
};

// Convert between linear light and a picture, whose values are the square roots of the light.
Picture toPicture(const Canvas& canvas);
Canvas toCanvas(const Picture& picture);

// Not inlined, like the other functions that handle a row of pixels: a browser replaces its first, slower code for a
// WebAssembly function by optimised code only between two calls.
template <class Paint>
[[gnu::noinline]] void paintRow(Rgb* pixels, int left, int right, int row, Paint& paint) {
    for (int column = left; column < right; ++column) paint(pixels[column], column, row);
}

// Calls paint(pixel, column, row) for the pixels of the canvas within `reach` of (x, y).
template <class Paint>
void forPixelsAround(Canvas& canvas, float x, float y, float reach, Paint paint) {
    const int left = std::max(0, static_cast<int>(x - reach));
    const int right = std::min(canvas.width, static_cast<int>(x + reach) + 2);
    const int top = std::max(0, static_cast<int>(y - reach));
    const int bottom = std::min(canvas.height, static_cast<int>(y + reach) + 2);
    for (int row = top; row < bottom; ++row) paintRow(&canvas.at(0, row), left, right, row, paint);
}

template <class Paint>
void forAllPixels(Canvas& canvas, Paint paint) {
    forPixelsAround(canvas, 0.0f, 0.0f, static_cast<float>(canvas.width + canvas.height), paint);
}

}  // namespace tidemark
