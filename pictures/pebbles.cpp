#include "pictures/pebbles.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <iterator>
#include <numbers>

namespace tidemark {

namespace {

struct Mineral {
    Rgb base, mottle;
    float veins;  // share of these pebbles that have a pale vein, 0 to 1
};

constexpr Mineral kMinerals[] = {
    {{0.075f, 0.095f, 0.115f}, {0.030f, 0.040f, 0.052f}, 0.5f},   // slate
    {{0.150f, 0.185f, 0.200f}, {0.085f, 0.110f, 0.130f}, 0.2f},   // blue-grey limestone
    {{0.340f, 0.215f, 0.105f}, {0.215f, 0.110f, 0.045f}, 0.2f},   // ochre sandstone
    {{0.265f, 0.095f, 0.055f}, {0.150f, 0.045f, 0.030f}, 0.35f},  // red jasper
    {{0.520f, 0.450f, 0.340f}, {0.370f, 0.290f, 0.195f}, 0.0f},   // cream quartz
    {{0.100f, 0.135f, 0.085f}, {0.055f, 0.080f, 0.050f}, 0.4f},   // serpentine
    {{0.235f, 0.200f, 0.175f}, {0.130f, 0.105f, 0.090f}, 0.3f},   // brown granite
    {{0.330f, 0.220f, 0.190f}, {0.240f, 0.135f, 0.115f}, 0.1f},   // rose feldspar
    {{0.045f, 0.050f, 0.055f}, {0.018f, 0.022f, 0.026f}, 0.3f},   // basalt
};

// Mixed into the colour of every stone.
constexpr Rgb kBank = {0.150f, 0.140f, 0.120f};

// Direction of the light: from the upper left, 45 degrees above the ground.
constexpr std::array<float, 3> kLight = {-0.50f, -0.58f, 0.643f};

struct Pebble {
    float x, y;                    // centre, in pixels
    float along, across;           // radii
    float cosine, sine;            // of the angle of the longer radius
    float lobe2, lobe3, lobeSkew;  // amplitudes of the outline's deviation from an ellipse
    float flatness;                // 0 for a ball, 1 for a disc with a rounded rim
    float shade;
    Mineral mineral;
    bool veined;
    float veinX, veinY, veinOffset, veinWidth;
    int cloudX, cloudY;
};

Pebble makePebble(float x, float y, float radius, Random& random) {
    const float angle = random.in(0.0f, 2.0f * std::numbers::pi_v<float>);
    const float stretch = random.in(1.0f, 1.55f);
    const Mineral& mineral = kMinerals[random.below(static_cast<int>(std::size(kMinerals)))];
    const float veinAngle = random.in(0.0f, std::numbers::pi_v<float>);
    Pebble pebble;
    pebble.x = x;
    pebble.y = y;
    pebble.along = radius * std::sqrt(stretch);
    pebble.across = radius / std::sqrt(stretch);
    pebble.cosine = std::cos(angle);
    pebble.sine = std::sin(angle);
    pebble.lobe2 = random.in(-0.06f, 0.06f);
    pebble.lobe3 = random.in(-0.07f, 0.07f);
    pebble.lobeSkew = random.in(-0.07f, 0.07f);
    pebble.flatness = random.in(0.2f, 0.8f);
    pebble.shade = random.in(0.8f, 1.15f);
    pebble.mineral = mineral;
    pebble.veined = random.in(0.0f, 1.0f) < mineral.veins;
    pebble.veinX = std::cos(veinAngle);
    pebble.veinY = std::sin(veinAngle);
    pebble.veinOffset = random.in(-0.45f, 0.45f);
    pebble.veinWidth = random.in(0.03f, 0.10f);
    pebble.cloudX = random.below(CloudTile::kSide);
    pebble.cloudY = random.below(CloudTile::kSide);
    return pebble;
}

void castShadow(Canvas& canvas, const Pebble& pebble) {
    const float radius = std::sqrt(pebble.along * pebble.across);
    const float x = pebble.x + 0.16f * radius;
    const float y = pebble.y + 0.20f * radius;
    forPixelsAround(canvas, x, y, pebble.along * 1.3f, [&](Rgb& pixel, int column, int row) {
        const float dx = static_cast<float>(column) - x;
        const float dy = static_cast<float>(row) - y;
        const float u = (dx * pebble.cosine + dy * pebble.sine) / pebble.along;
        const float v = (dy * pebble.cosine - dx * pebble.sine) / pebble.across;
        const float depth = std::clamp((1.69f - (u * u + v * v)) / 0.9f, 0.0f, 1.0f);
        const float light = 1.0f - 0.82f * depth * depth * (3.0f - 2.0f * depth);
        pixel = pixel * light;
    });
}

// Returns the colour of the stone at (u, v), each from -1 to 1 across the stone.
Rgb stoneColour(const Pebble& pebble, const CloudTile& clouds, float u, float v, int column, int row) {
    const float cloud = clouds.at(column * 2 + pebble.cloudX, row * 2 + pebble.cloudY);
    const float grain = grainAt(column, row);
    Rgb colour = mix(pebble.mineral.mottle, pebble.mineral.base, std::clamp(cloud * 2.2f - 0.6f, 0.0f, 1.0f));
    const float shade = pebble.shade * (0.86f + 0.28f * grain);
    colour = mix(colour * shade, kBank, 0.45f);
    if (pebble.veined) {
        const float wander = (cloud - 0.5f) * 0.35f;
        const float away = std::abs(u * pebble.veinX + v * pebble.veinY + wander - pebble.veinOffset);
        const float vein = std::clamp(1.5f - away / pebble.veinWidth, 0.0f, 1.0f);
        colour = mix(colour, {0.34f, 0.32f, 0.29f}, vein * 0.5f);
    }
    return colour;
}

void drawPebble(Canvas& canvas, const Pebble& pebble, const CloudTile& clouds) {
    forPixelsAround(canvas, pebble.x, pebble.y, pebble.along * 1.15f, [&](Rgb& pixel, int column, int row) {
        const float dx = static_cast<float>(column) - pebble.x;
        const float dy = static_cast<float>(row) - pebble.y;
        const float u = (dx * pebble.cosine + dy * pebble.sine) / pebble.along;
        const float v = (dy * pebble.cosine - dx * pebble.sine) / pebble.across;
        const float square = u * u + v * v;
        if (square > 1.5f) return;
        const float distance = std::sqrt(square) + 1e-6f;
        const float lobes = pebble.lobe2 * (u * u - v * v) / (square + 1e-6f) +
                            pebble.lobe3 * u * (u * u - 3.0f * v * v) / (square * distance + 1e-6f) +
                            pebble.lobeSkew * v * (3.0f * u * u - v * v) / (square * distance + 1e-6f);
        const float rim = distance * (1.0f + lobes);
        const float coverage = std::clamp((1.0f - rim) * pebble.across + 0.5f, 0.0f, 1.0f);
        if (coverage <= 0.0f) return;

        const float ball = 0.75f * rim;
        const float disc = 1.5f * rim * rim * rim * rim;
        const float slope = ball + (disc - ball) * pebble.flatness;
        const float outU = u / distance * slope;
        const float outV = v / distance * slope;
        const float bump = (clouds.at(column * 3 + pebble.cloudX, row * 3 + pebble.cloudY) -
                            clouds.at(column * 3 + pebble.cloudX + 3, row * 3 + pebble.cloudY + 3)) *
                           0.5f;
        const float nx = outU * pebble.cosine - outV * pebble.sine + bump;
        const float ny = outU * pebble.sine + outV * pebble.cosine + bump;
        const float facing = (nx * kLight[0] + ny * kLight[1] + kLight[2]) / std::sqrt(nx * nx + ny * ny + 1.0f);
        const float diffuse = std::max(facing, 0.0f);
        const float gloss = diffuse * diffuse;
        const float light = 0.20f + 1.35f * diffuse * (0.6f + 0.4f * diffuse);
        const float glint = 0.05f * gloss * gloss * gloss * gloss;
        const Rgb stone = stoneColour(pebble, clouds, u, v, column, row);
        // The sky lights the sides that face away from the sun.
        const Rgb lit = {stone.r * light + glint, stone.g * (light + 0.03f) + glint, stone.b * (light + 0.08f) + glint};
        pixel = mix(pixel, lit, coverage);
    });
}

void spreadSand(Canvas& canvas, const CloudTile& clouds) {
    forAllPixels(canvas, [&](Rgb& pixel, int column, int row) {
        const float light = 0.4f + 0.6f * clouds.at(column, row) + 0.5f * grainAt(column, row);
        pixel = {0.22f * light, 0.17f * light, 0.115f * light};
    });
}

void scatter(Canvas& canvas, float smallest, float largest, float layers, Random& random, const CloudTile& clouds) {
    const float area = static_cast<float>(canvas.width) * static_cast<float>(canvas.height) * layers;
    float covered = 0.0f;
    while (covered < area) {
        const float pick = random.in(0.0f, 1.0f);
        const float radius = smallest + (largest - smallest) * pick * pick;
        const float x = random.in(-radius, static_cast<float>(canvas.width) + radius);
        const float y = random.in(-radius, static_cast<float>(canvas.height) + radius);
        const Pebble pebble = makePebble(x, y, radius, random);
        castShadow(canvas, pebble);
        drawPebble(canvas, pebble, clouds);
        covered += std::numbers::pi_v<float> * radius * radius;
    }
}

}  // namespace

void scatterPebbles(Canvas& canvas, float unit, Random& random, const CloudTile& clouds) {
    spreadSand(canvas, clouds);
    scatter(canvas, 0.15f * unit, 0.45f * unit, 0.7f, random, clouds);
    scatter(canvas, 0.40f * unit, 1.40f * unit, 1.25f, random, clouds);
    scatter(canvas, 0.15f * unit, 0.50f * unit, 0.14f, random, clouds);
    scatter(canvas, 1.50f * unit, 2.20f * unit, 0.05f, random, clouds);
    scatter(canvas, 0.14f * unit, 0.32f * unit, 0.03f, random, clouds);
}

}  // namespace tidemark
