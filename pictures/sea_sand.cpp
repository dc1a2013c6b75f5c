#include "pictures/sea_sand.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

#include "pictures/turn.h"

namespace tidemark {

namespace {

constexpr float kPi = std::numbers::pi_v<float>;

// Heights of the sand ripples at successive points of a row, from 0 to 1. Ripples meander, split and join; their crests
// are sharper than their troughs. Coordinates are in units.
class RibRow {
public:
    RibRow(float u, float v, float step)
        : u_(u),
          v_(v),
          step_(step),
          bends_{along(0.21f, 0.13f, 0.0f), along(0.11f, -0.34f, 1.7f), along(0.55f, 0.23f, 0.4f)},
          height_(along(0.17f, -0.29f, 0.0f)) {}

    float next() {
        const float u = u_ + static_cast<float>(points_++) * step_;
        const float bend = 1.3f * bends_[0].sine() + 0.9f * bends_[1].sine() + 0.5f * bends_[2].sine();
        const float wave = 0.5f + 0.5f * std::sin(v_ * 2.6f + 0.5f * u + 1.2f * bend);
        const float rib = wave * wave * (0.75f + 0.25f * height_.sine());
        for (Turn& turn : bends_) turn.advance();
        height_.advance();
        return rib;
    }

private:
    Turn along(float ku, float kv, float phase) const { return {ku * u_ + kv * v_ + phase, ku * step_}; }

    float u_, v_, step_;
    int points_ = 0;
    std::array<Turn, 3> bends_;
    Turn height_;
};

struct Starfish {
    float x, y, size, turn;
    Rgb skin;
};

// Returns the distance from the centre of a starfish to its rim, `a` radians from the nearest arm.
float reachAt(float a) {
    const float along = std::max(0.0f, std::cos(a));
    const float square = along * along;
    const float fourth = square * square;
    return 0.30f + 0.70f * square * fourth * fourth * fourth;
}

void drawStarfish(Canvas& canvas, const Starfish& star) {
    const auto at = [&](float dx, float dy) {
        const float distance = std::sqrt(dx * dx + dy * dy) / star.size;
        constexpr float kFifth = 2.0f * kPi / 5.0f;
        const float arms = (std::atan2(dy, dx) - star.turn) / kFifth;
        const float fromArm = kFifth * std::abs(arms - std::floor(arms + 0.5f));
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
        const float knob = std::max(0.0f, 1.0f - across * 28.0f) *
                           (0.5f + 0.5f * std::cos(std::sqrt(dx * dx + dy * dy) / star.size * 55.0f));
        const float side = 0.16f * (-dx - dy) / star.size;
        Rgb skin = star.skin * (0.50f + 0.55f * round + side + 0.25f * grainAt(column, row));
        skin = mix(skin, {0.85f, 0.66f, 0.42f}, 0.65f * knob);
        pixel = mix(pixel, skin, coverage);
    });
}

[[gnu::noinline]] void rakeRow(Canvas& canvas, int row, float unit, const CloudTile& clouds) {
    constexpr float kStep = 0.12f;
    const float pixelSide = 1.0f / unit;
    const float v = static_cast<float>(row) * pixelSide;
    RibRow ribs(0.0f, v, pixelSide);
    RibRow ribsBeside(-0.5f * kStep, v - kStep, pixelSide);
    for (int column = 0; column < canvas.width; ++column) {
        const float rib = ribs.next();
        const float slope = rib - ribsBeside.next();
        const float cloud = clouds.at(column, row);
        const float light = 0.80f + 1.5f * slope + 0.35f * (cloud - 0.5f) + 0.22f * (grainAt(column, row) - 0.5f);
        const float trough = 1.0f - rib;
        Rgb& pixel = canvas.at(column, row);
        pixel = mix({0.58f, 0.47f, 0.30f}, {0.36f, 0.29f, 0.20f}, 0.6f * trough * trough) * light;
        // Dark grains collect in the troughs.
        if (grainAt(column + 7919, row) > 0.985f) pixel = pixel * 0.45f;
    }
}

}  // namespace

void rakeSand(Canvas& canvas, float unit, Random& random, const CloudTile& clouds) {
    for (int row = 0; row < canvas.height; ++row) rakeRow(canvas, row, unit, clouds);
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
