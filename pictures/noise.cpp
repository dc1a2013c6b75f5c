#include "pictures/noise.h"

#include <cstdint>

namespace tidemark {

namespace {

float smooth(float t) {
    return t * t * (3.0f - 2.0f * t);
}

void addOctave(std::vector<float>& values, int cell, float amplitude, Random& random) {
    const int side = CloudTile::kSide;
    const int knots = side / cell;
    std::vector<float> lattice(static_cast<std::size_t>(knots) * static_cast<std::size_t>(knots));
    for (float& knot : lattice) knot = random.in(-amplitude, amplitude);
    const auto knot = [&](int column, int row) {
        return lattice[static_cast<std::size_t>((row % knots) * knots + column % knots)];
    };
    for (int y = 0; y < side; ++y) {
        const float fy = smooth(static_cast<float>(y % cell) / static_cast<float>(cell));
        for (int x = 0; x < side; ++x) {
            const float fx = smooth(static_cast<float>(x % cell) / static_cast<float>(cell));
            const int column = x / cell;
            const int row = y / cell;
            const float upper = knot(column, row) + (knot(column + 1, row) - knot(column, row)) * fx;
            const float lower = knot(column, row + 1) + (knot(column + 1, row + 1) - knot(column, row + 1)) * fx;
            values[static_cast<std::size_t>(y * side + x)] += upper + (lower - upper) * fy;
        }
    }
}

}  // namespace

float grainAt(int column, int row) {
    std::uint32_t bits =
        static_cast<std::uint32_t>(column) * 0x9E3779B1U ^ static_cast<std::uint32_t>(row) * 0x85EBCA77U;
    bits = (bits ^ (bits >> 15U)) * 0x2C1B3C6DU;
    return static_cast<float>(bits >> 8U) * 0x1p-24f;
}

CloudTile::CloudTile(unsigned seed) : values_(std::size_t{kSide} * kSide, 0.5f) {
    Random random(seed);
    float amplitude = 0.35f;
    for (int cell = kSide / 4; cell >= 2; cell /= 2) {
        addOctave(values_, cell, amplitude, random);
        amplitude *= 0.55f;
    }
}

}  // namespace tidemark
