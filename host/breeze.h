// The waves of a breeze: long, low and slow. They are added to the heights that are drawn; the water's own waves never
// know of them.
#pragma once

#include <vector>

#include "host/wave_lattice.h"

namespace tidemark {

class Breeze {
public:
    explicit Breeze(const WaveLattice& lattice);

    // Lets the waves be as they are at `time`, in seconds; where crests meet they reach `height`.
    void blow(float height, double time);

    // Adds them to `count` heights of a column of the lattice, from `row` on.
    void add(int column, int row, int count, float* heights) const;

private:
    static constexpr int kWaves = 5;

    // The phase of a wave is the phase of its column plus that of its row minus that of the time. Sums of angles are
    // taken from the cosines and sines of the parts, so that a frame computes those of the time only.
    struct Angle {
        double cosine, sine;
    };
    int points_;
    std::vector<Angle> columns_;          // kWaves a column
    std::vector<float> cosines_, sines_;  // of the rows, wave by wave
    Angle now_[kWaves] = {};
    float height_ = 0.0f;
};

}  // namespace tidemark
