#include "preview/fields.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

#include "host/engine_window.h"
#include "pictures/canvas.h"

namespace tidemark {

namespace {

// A grid of values. Beyond an edge it repeats the values at the edge.
struct Grid {
    const float* values;
    int width, height;

    float at(int x, int y) const { return values[std::clamp(y, 0, height - 1) * width + std::clamp(x, 0, width - 1)]; }
};

constexpr Rgb kPaper = {0.91f, 0.89f, 0.84f};

// Returns the colour at `t`, 0 to 1, in a gradient of equally spaced colours.
template <std::size_t N>
Rgb colourAt(const Rgb (&colours)[N], float t) {
    const float place = std::clamp(t, 0.0f, 1.0f) * static_cast<float>(N - 1);
    const auto below = std::min(static_cast<std::size_t>(place), N - 2);
    return mix(colours[below], colours[below + 1], place - static_cast<float>(below));
}

// Interpolates between b and c, t from 0 to 1; a and d are the outer neighbours (Catmull and Rom, 1974).
float cubic(float a, float b, float c, float d, float t) {
    return b + 0.5f * t * (c - a + t * (2.0f * a - 5.0f * b + 4.0f * c - d + t * (3.0f * (b - c) + d - a)));
}

// Returns the height at each pixel's centre. The view shows the middle of the square lattice.
std::vector<float> heightsInView(const WaterHost& host, int width, int height, float cellsPerPixel) {
    const int n = host.lattice().points;
    const Grid mesh = {host.heights().data(), n, n};  // a row of the grid is a column of the mesh
    const auto place = [=](int pixel, int pixels) {
        return 0.5f * static_cast<float>(n - 1) + 0.5f * static_cast<float>(2 * pixel + 1 - pixels) * cellsPerPixel;
    };
    std::vector<float> heights;
    heights.reserve(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    for (int y = 0; y < height; ++y) {
        const float down = place(y, height);
        const int top = static_cast<int>(down);
        for (int x = 0; x < width; ++x) {
            const float across = place(x, width);
            const int left = static_cast<int>(across);
            float h[4];
            for (int i = 0; i < 4; ++i) {
                const auto at = [&](int j) { return mesh.at(top + j, left - 1 + i); };
                h[i] = cubic(at(-1), at(0), at(1), at(2), down - static_cast<float>(top));
            }
            heights.push_back(cubic(h[0], h[1], h[2], h[3], across - static_cast<float>(left)));
        }
    }
    return heights;
}

Picture drawHeight(const WaterHost& host, const Look& look, int width, int height) {
    constexpr Rgb kColours[] = {{0.010f, 0.030f, 0.160f}, {0.040f, 0.220f, 0.520f}, {0.380f, 0.640f, 0.800f}, kPaper,
                                {0.900f, 0.480f, 0.260f}, {0.600f, 0.080f, 0.040f}, {0.180f, 0.005f, 0.020f}};
    const float cellsPerPixel =
        static_cast<float>(host.lattice().points - 1) / look.pictureZoom / static_cast<float>(std::max(width, height));
    const std::vector<float> heights = heightsInView(host, width, height, cellsPerPixel);
    const Grid view = {heights.data(), width, height};
    Canvas canvas(width, height);
    forAllPixels(canvas, [&](Rgb& pixel, int x, int y) {
        // At heights of 1.13 and above, the water texture has its full weight. The light is at the upper left.
        const float h = view.at(x, y);
        const float t = 0.5f + 0.5f * std::copysign(std::pow(std::abs(h) / 1.13f, 0.8f), h);
        const float rise = view.at(x + 1, y) - view.at(x - 1, y) + view.at(x, y + 1) - view.at(x, y - 1);
        pixel = colourAt(kColours, t) * std::clamp(1.0f + 0.35f * rise / cellsPerPixel, 0.5f, 1.6f);
    });
    return toPicture(canvas);
}

// Draws an arrow with its centre at (x, y) and a unit direction, in pixels. A longer arrow has a wider shaft.
void drawArrow(Canvas& canvas, float x, float y, float directionX, float directionY, float length, Rgb colour) {
    const float head = std::min(0.6f * length, 7.0f);
    forPixelsAround(canvas, x, y, 0.5f * length + 4.0f, [&](Rgb& pixel, int column, int row) {
        const float dx = static_cast<float>(column) + 0.5f - x;
        const float dy = static_cast<float>(row) + 0.5f - y;
        const float fromTail = 0.5f * length + dx * directionX + dy * directionY;
        const float toTip = length - fromTail;
        const float aside = std::abs(dy * directionX - dx * directionY);
        // The distances by which the pixel is inside the shaft and inside the head.
        const float inHead = std::min(0.45f * toTip - aside, head - toTip);
        const float inShaft = std::min({0.35f + 0.65f * fromTail / length - aside, fromTail, toTip - 0.7f * head});
        pixel = mix(pixel, colour, std::clamp(std::max(inHead, inShaft) + 0.5f, 0.0f, 1.0f));
    });
}

Picture drawVelocity(const Picture& result, const EngineView& engine) {
    constexpr Rgb kColours[] = {
        {0.080f, 0.450f, 0.600f}, {0.200f, 0.850f, 0.700f}, {0.900f, 0.850f, 0.220f}, {1.000f, 0.400f, 0.100f}};
    constexpr float kFastest = 60.0f;
    constexpr int kCells = 2;  // distance between two arrows
    Canvas canvas = toCanvas(result);
    forAllPixels(canvas, [](Rgb& pixel, int, int) {
        const float grey = 0.3f * pixel.r + 0.6f * pixel.g + 0.1f * pixel.b;
        pixel = mix(pixel, {grey, grey, grey}, 0.6f) * 0.15f;
    });
    const float cellWidth = static_cast<float>(result.width) / static_cast<float>(engine.gridWidth);
    const float cellHeight = static_cast<float>(result.height) / static_cast<float>(engine.gridHeight);
    for (int j = kCells / 2; j < engine.gridHeight; j += kCells) {
        for (int i = kCells / 2; i < engine.gridWidth; i += kCells) {
            const float* const u = &engine.velocity[static_cast<std::size_t>(2 * (j * engine.gridWidth + i))];
            const float speed = std::hypot(u[0], u[1]);
            const float t = std::sqrt(std::min(speed / kFastest, 1.0f));
            if (!(t > 0.04f)) continue;
            const float x = (static_cast<float>(i) + 0.5f) * cellWidth;
            const float y = static_cast<float>(result.height) - (static_cast<float>(j) + 0.5f) * cellHeight;
            drawArrow(canvas, x, y, u[0] / speed, -u[1] / speed, 6.0f + 28.0f * t, colourAt(kColours, t));
        }
    }
    return toPicture(canvas);
}

// Darkens paper with the formula of the water's fragment shader.
Picture drawDensity(int width, int height, const EngineView& engine) {
    const Grid ink = {engine.density.data(), engine.inkWidth, engine.inkHeight};
    const float columnsPerPixel = static_cast<float>(ink.width) / static_cast<float>(width);
    const float rowsPerPixel = static_cast<float>(ink.height) / static_cast<float>(height);
    Canvas canvas(width, height);
    forAllPixels(canvas, [&](Rgb& pixel, int x, int y) {
        const float column = (static_cast<float>(x) + 0.5f) * columnsPerPixel - 0.5f;
        const float row = (static_cast<float>(height - y) - 0.5f) * rowsPerPixel - 0.5f;
        const int i = static_cast<int>(std::floor(column));
        const int j = static_cast<int>(std::floor(row));
        const float right = column - static_cast<float>(i);
        const float up = row - static_cast<float>(j);
        const auto along = [&](int line) { return std::lerp(ink.at(i, line), ink.at(i + 1, line), right); };
        const float value = std::lerp(along(j), along(j + 1), up);
        const auto through = [value](float paper, float tint) {
            const float divisor = 1.0f + value * tint;
            return paper / (divisor * divisor);  // in linear light; the shader divides its square root
        };
        const float* const tint = engine.tint;
        pixel = {through(kPaper.r, tint[0]), through(kPaper.g, tint[1]), through(kPaper.b, tint[2])};
    });
    return toPicture(canvas);
}

}  // namespace

std::string fieldName(int picture) {
    constexpr const char* kNames[] = {"height.png", "velocity.png", "density.png", "result.png"};
    return kNames[picture];
}

std::array<Picture, 4> drawFields(const WaterHost& host, const Look& look, const Picture& result) {
    const EngineView engine = lookIntoEngine();
    return {
        drawHeight(host, look, result.width, result.height), drawVelocity(result, engine),
        drawDensity(result.width, result.height, engine), result};
}

}  // namespace tidemark
