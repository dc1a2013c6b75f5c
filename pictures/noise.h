// Random numbers and cloudy noise that come out the same on every machine.
#pragma once

#include <cstddef>
#include <random>
#include <vector>

namespace tidemark {

class Random {
public:
    explicit Random(unsigned seed) : engine_(seed) {}

    // Uniform in [low, high). The distributions of <random> differ from one library to the next.
    float in(float low, float high) { return low + (high - low) * static_cast<float>(engine_() >> 8U) * 0x1p-24f; }
    int below(int count) { return static_cast<int>(in(0.0f, static_cast<float>(count))); }

private:
    std::mt19937 engine_;
};

// Rough as a broken stone: 0 to 1, another value at every place.
float grainAt(int column, int row);

// A square of clouds, about 0 to 1 and 0.5 on average, that repeats seamlessly.
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
