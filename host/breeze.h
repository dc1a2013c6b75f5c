// A breeze: long, low, slow waves. They are added only to the drawn heights and do not affect the water's own waves.
#pragma once

#include <vector>

#include "host/wave_lattice.h"

namespace tidemark {

class Breeze {
public:
    explicit Breeze(const WaveLattice& lattice);

    // Sets the time in seconds, and the height at points where all crests meet.
    void blow(float height, double time);

    // Adds the waves to `count` heights of a column of the lattice, beginning with `row`.
    void add(int column, int row, int count, float* heights) const;

private:
    static constexpr int kWaves = 5;

    // The phase of a wave is the sum of a column's and a row's phase minus the time's. By the angle sum identities a
    // frame needs the cosine and sine of the time's phase only.
    struct Angle {
        double cosine, sine;
    };
    int points_;
    std::vector<Angle> columns_;          // kWaves for each column
    std::vector<float> cosines_, sines_;  // for each wave, all rows
    Angle now_[kWaves] = {};
    float height_ = 0.0f;
};

}  // namespace tidemark
