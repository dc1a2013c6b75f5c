#include "host/wave_lattice.h"

#include <algorithm>
#include <cmath>

namespace tidemark {

namespace {

// Stability limit: with a larger factor on the curvature, the shortest waves grow from rounding errors.
constexpr double kMostWaveSpeed = 0.45;

// The library's ripples have a radius of three cells.
constexpr double kRippleCells = 3.0;

}  // namespace

WaveLattice latticeFor(const Look& look, int width, int height) {
    const double longer = std::max(width, height);
    const double sides = longer / std::sqrt(static_cast<double>(width) * height * 16.0 / 9.0);  // in view heights
    const double spanned = look.pictureZoom * sides;
    WaveLattice lattice;
    lattice.points =
        static_cast<int>(std::clamp(std::floor(spanned * kRippleCells / look.dropRadius + 1.5), 16.0, 256.0));
    lattice.extent = std::max(static_cast<int>(std::floor(look.meshExtent * sides + 0.5)), 1);

    // Uses shorter steps if the waves would cross more than the stable part of a cell in one.
    const double cell = spanned / (lattice.points - 1);
    lattice.cell = cell;
    const double cellsPerStep = look.ringSpeed / (cell * look.stepsPerSecond);
    const double steps = std::clamp(std::ceil(cellsPerStep / std::sqrt(kMostWaveSpeed)), 1.0, 8.0);
    lattice.stepsPerSecond = look.stepsPerSecond * static_cast<int>(steps);
    const double waveSpeed = std::min(cellsPerStep / steps * (cellsPerStep / steps), kMostWaveSpeed);

    // Waves decay at half the rate at which speeds are damped, and exp(-3) is 5 %. The damping (1 - x/2) / (1 + x/2)
    // approximates exp(-x) with an error of x^3 / 12.
    const double x = 6.0 / (double{look.calmingTime} * lattice.stepsPerSecond);
    const double damping = std::max((2.0 - x) / (2.0 + x), 0.0);
    lattice.waveSpeed = look.waveSpeed > 0.0f ? look.waveSpeed : static_cast<float>(waveSpeed);
    lattice.damping = look.damping > 0.0f ? look.damping : static_cast<float>(damping);
    return lattice;
}

}  // namespace tidemark
