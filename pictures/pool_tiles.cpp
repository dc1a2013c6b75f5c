#include "pictures/pool_tiles.h"

#include <algorithm>
#include <cmath>

namespace tidemark {

namespace {

constexpr Rgb kGlazes[] = {
    {0.006f, 0.050f, 0.105f},  // petrol
    {0.010f, 0.105f, 0.165f},  // teal
    {0.020f, 0.170f, 0.215f},  // turquoise
    {0.070f, 0.255f, 0.265f},  // aqua
    {0.220f, 0.370f, 0.330f},  // celadon
};
constexpr Rgb kGold = {0.380f, 0.210f, 0.045f};
constexpr Rgb kGrout = {0.300f, 0.330f, 0.300f};

struct Scale {
    int column, row;
    float x, y;  // position relative to the tile's centre, in radii
};

// Returns the tile at a position. The tiles are rows of discs; each row is shifted by half a tile and overlaps the row
// below.
Scale scaleAt(float x, float y, float radius) {
    const int upper = static_cast<int>(std::floor(y / radius));
    Scale scale{};
    for (const int row : {upper, upper + 1}) {
        const float shift = row % 2 == 0 ? 0.0f : radius;
        const int column = static_cast<int>(std::lround((x - shift) / (2.0f * radius)));
        const float dx = (x - shift) / radius - 2.0f * static_cast<float>(column);
        const float dy = y / radius - static_cast<float>(row);
        scale = {column, row, dx, dy};
        if (dx * dx + dy * dy <= 1.0f) break;
    }
    return scale;
}

}  // namespace

void layTiles(Canvas& canvas, float unit, const CloudTile& clouds) {
    const float seam = std::max(0.05f, 0.7f / unit);
    forAllPixels(canvas, [&](Rgb& pixel, int column, int row) {
        const Scale scale = scaleAt(static_cast<float>(column), static_cast<float>(row), unit);
        const float pick = grainAt(scale.column + 1000, scale.row + 1000);
        const float drift = clouds.at(scale.column * 23, scale.row * 17);
        const float shade = std::clamp(4.0f * (0.55f * pick + 0.9f * drift - 0.25f), 0.0f, 3.999f);
        const auto glaze = static_cast<std::size_t>(shade);
        Rgb colour = mix(kGlazes[glaze], kGlazes[glaze + 1], shade - static_cast<float>(glaze));
        if (pick > 0.965f) colour = kGold;

        const float distance = std::sqrt(scale.x * scale.x + scale.y * scale.y);
        const float cloud = clouds.at(column * 2, row * 2);
        // The glaze is thinner at the rim and reflects light above the middle.
        const float rim = std::clamp(distance, 0.0f, 1.0f);
        const float glint = std::max(0.0f, 1.0f - 3.5f * std::hypot(scale.x + 0.25f, scale.y - 0.3f));
        colour = colour * (0.72f + 0.25f * cloud + 0.40f * rim * rim + 0.5f * glint * glint);
        const float grout = std::clamp((distance - 1.0f + seam) / seam * 1.5f, 0.0f, 1.0f);
        pixel = mix(colour, kGrout * (0.6f + 0.5f * cloud), grout);
    });
}

}  // namespace tidemark
