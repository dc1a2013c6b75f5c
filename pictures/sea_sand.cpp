#include "pictures/sea_sand.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace tidemark {

namespace {

constexpr float kPi = std::numbers::pi_v<float>;

// Sand ripples meander, split and join; their crests are sharper than their troughs.
float ribAt(float x, float y, float unit) {
    const float u = x / unit;
    const float v = y / unit;
    const float bend = 1.3f * std::sin(0.21f * u + 0.13f * v) + 0.9f * std::sin(0.11f * u - 0.34f * v + 1.7f) +
                       0.5f * std::sin(0.55f * u + 0.23f * v + 0.4f);
    const float wave = 0.5f + 0.5f * std::sin(v * 2.6f + 0.5f * u + 1.2f * bend);
    return wave * wave * (0.75f + 0.25f * std::sin(0.17f * u - 0.29f * v));
}

struct Starfish {
    float x, y, size, turn;
    Rgb skin;
};

// Returns the distance from the centre of a starfish to its rim, `a` radians from the nearest arm.
float reachAt(float a) {
    const float along = std::max(0.0f, std::cos(a));
    return 0.30f + 0.70f * std::pow(along, 14.0f);
}

void drawStarfish(Canvas& canvas, const Starfish& star) {
    const auto at = [&](float dx, float dy) {
        const float distance = std::hypot(dx, dy) / star.size;
        const float fifth = 2.0f * kPi / 5.0f;
        const float angle = std::atan2(dy, dx) - star.turn + 10.0f * kPi;
        const float fromArm = std::abs(std::remainder(angle, fifth));
        return std::pair{distance / reachAt(fromArm), distance * std::sin(fromArm)};
    };
    const float shift = 0.07f * star.size;
    forPixelsAround(canvas, star.x, star.y, star.size * 1.2f, [&](Rgb& pixel, int column, int row) {
        const float dx = static_cast<float>(column) - star.x;
        const float dy = static_cast<float>(row) - star.y;
        const float shadow = std::clamp((1.25f - at(dx - shift, dy - shift).first) * 2.5f, 0.0f, 1.0f);
        pixel = pixel * (1.0f - 0.55f * shadow);
        const auto [rim, across] = at(dx, dy);
        const float coverage = std::clamp((1.0f - rim) * 0.35f * star.size + 0.5f, 0.0f, 1.0f);
        if (coverage <= 0.0f) return;
        // Rounded arms with a row of pale knobs.
        const float round = std::sqrt(std::max(0.0f, 1.0f - rim * rim));
        const float knob =
            std::max(0.0f, 1.0f - across * 28.0f) * (0.5f + 0.5f * std::cos(std::hypot(dx, dy) / star.size * 55.0f));
        const float side = 0.16f * (-dx - dy) / star.size;
        Rgb skin = star.skin * (0.50f + 0.55f * round + side + 0.25f * grainAt(column, row));
        skin = mix(skin, {0.85f, 0.66f, 0.42f}, 0.65f * knob);
        pixel = mix(pixel, skin, coverage);
    });
}

}  // namespace

void rakeSand(Canvas& canvas, float unit, Random& random, const CloudTile& clouds) {
    forAllPixels(canvas, [&](Rgb& pixel, int column, int row) {
        const auto x = static_cast<float>(column);
        const auto y = static_cast<float>(row);
        const float step = 0.12f * unit;
        const float slope = ribAt(x, y, unit) - ribAt(x - 0.5f * step, y - step, unit);
        const float cloud = clouds.at(column, row);
        const float light = 0.80f + 1.5f * slope + 0.35f * (cloud - 0.5f) + 0.22f * (grainAt(column, row) - 0.5f);
        const float trough = 1.0f - ribAt(x, y, unit);
        pixel = mix({0.58f, 0.47f, 0.30f}, {0.36f, 0.29f, 0.20f}, 0.6f * trough * trough) * light;
        // Dark grains collect in the troughs.
        if (grainAt(column + 7919, row) > 0.985f) pixel = pixel * 0.45f;
    });
    const auto width = static_cast<float>(canvas.width);
    const auto height = static_cast<float>(canvas.height);
    const auto star = [&](float x, float y, float size, Rgb skin) {
        drawStarfish(canvas, {x * width, y * height, size * unit, random.in(0.0f, 2.0f * kPi), skin});
    };
    star(0.28f, 0.30f, 3.0f, {0.72f, 0.24f, 0.07f});
    star(0.74f, 0.62f, 2.3f, {0.62f, 0.13f, 0.10f});
    star(0.38f, 0.83f, 1.6f, {0.75f, 0.42f, 0.14f});
}

}  // namespace tidemark
