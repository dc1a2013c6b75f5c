// Random numbers and noise with the same values on every platform.
#pragma once

#include <cstddef>
#include <random>
#include <vector>

namespace tidemark {

class Random {
public:
    explicit Random(unsigned seed) : engine_(seed) {}

    // Returns a number in [low, high), uniformly distributed. The distributions of <random> differ between standard
    // libraries.
    float in(float low, float high) { return low + (high - low) * static_cast<float>(engine_() >> 8U) * 0x1p-24f; }
    int below(int count) { return static_cast<int>(in(0.0f, static_cast<float>(count))); }

private:
    std::mt19937 engine_;
};

// White noise: returns an independent value from 0 to 1 for each position.
float grainAt(int column, int row);

// Cloud noise, about 0 to 1 with a mean of 0.5; the square repeats without a seam.
class CloudTile {
public:
    static constexpr int kSide = 512;

    explicit CloudTile(unsigned seed);

    float at(int x, int y) const {
        return values_[static_cast<std::size_t>(y & (kSide - 1)) * kSide + static_cast<std::size_t>(x & (kSide - 1))];
    }

private:
    std::vector<float> values_;
};

}  // namespace tidemark
