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
    struct Wave {
        double turn, speed;                 // of the phase: a column to the right, a second
        float share;                        // of the height
        std::vector<float> cosines, sines;  // of the phase, row by row
    };
    std::vector<Wave> waves_;
    float height_ = 0.0f;
    double time_ = 0.0;
};

}  // namespace tidemark
