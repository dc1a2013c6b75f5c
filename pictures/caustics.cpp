#include "pictures/caustics.h"

#include <array>
#include <cmath>
#include <numbers>

#include "pictures/noise.h"
#include "pictures/turn.h"

namespace tidemark {

namespace {

constexpr int kWaves = 14;
constexpr float kFocus = 0.011f;     // displacement of the light per unit of slope, in squared cells
constexpr float kPhotonStep = 0.5f;  // pixels between neighbouring photons

struct Wave {
    float kx, ky, phase, amplitude;
};

std::array<Wave, kWaves> makeWaves(float cell, unsigned seed) {
    Random random(seed);
    std::array<Wave, kWaves> waves;
    for (Wave& wave : waves) {
        const float angle = random.in(0.0f, 2.0f * std::numbers::pi_v<float>);
        const float length = cell * random.in(0.8f, 2.6f);
        const float k = 2.0f * std::numbers::pi_v<float> / length;
        wave = {k * std::cos(angle), k * std::sin(angle), random.in(0.0f, 7.0f), kFocus * cell * length};
    }
    return waves;
}

// Moves the photons of a row, which starts at (x, y).
[[gnu::noinline]] void bend(const Wave& wave, float x, float y, std::vector<float>& landX, std::vector<float>& landY) {
    Turn turn(wave.kx * x + wave.ky * y + wave.phase, wave.kx * kPhotonStep);
    for (std::size_t i = 0; i < landX.size(); ++i) {
        landX[i] += wave.amplitude * wave.kx * turn.cosine();
        landY[i] += wave.amplitude * wave.ky * turn.cosine();
        turn.advance();
    }
}

// Adds a photon's brightness to the four nearest pixels.
void deposit(std::vector<float>& map, int width, int height, float x, float y) {
    const float left = std::floor(x);
    const float top = std::floor(y);
    const float energy = kPhotonStep * kPhotonStep;
    for (int corner = 0; corner < 4; ++corner) {
        const int column = static_cast<int>(left) + corner % 2;
        const int row = static_cast<int>(top) + corner / 2;
        if (column < 0 || row < 0 || column >= width || row >= height) continue;
        const float shareX = 1.0f - std::abs(x - static_cast<float>(column));
        const float shareY = 1.0f - std::abs(y - static_cast<float>(row));
        map[static_cast<std::size_t>(row) * static_cast<std::size_t>(width) + static_cast<std::size_t>(column)] +=
            energy * shareX * shareY;
    }
}

[[gnu::noinline]] void depositRow(
    std::vector<float>& map, int width, int height, const std::vector<float>& x, const std::vector<float>& y) {
    for (std::size_t i = 0; i < x.size(); ++i) deposit(map, width, height, x[i], y[i]);
}

}  // namespace

std::vector<float> causticNet(int width, int height, float cell, unsigned seed) {
    std::vector<float> map(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
    const std::array<Wave, kWaves> waves = makeWaves(cell, seed);
    // Also emit photons outside the picture, because some land inside.
    const float margin = std::ceil(cell);
    const int columns = static_cast<int>((static_cast<float>(width) + 2.0f * margin) / kPhotonStep);
    const int rows = static_cast<int>((static_cast<float>(height) + 2.0f * margin) / kPhotonStep);
    std::vector<float> landX(static_cast<std::size_t>(columns));
    std::vector<float> landY(static_cast<std::size_t>(columns));
    for (int row = 0; row < rows; ++row) {
        const float y = static_cast<float>(row) * kPhotonStep - margin;
        for (int i = 0; i < columns; ++i) {
            landX[static_cast<std::size_t>(i)] = static_cast<float>(i) * kPhotonStep - margin;
            landY[static_cast<std::size_t>(i)] = y;
        }
        for (const Wave& wave : waves) bend(wave, -margin, y, landX, landY);
        depositRow(map, width, height, landX, landY);
    }
    return map;
}

}  // namespace tidemark
