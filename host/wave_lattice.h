// The lattice on which the waves live. Its cells are a share of the view and its steps a share of a second, so that
// waves look and move the same on any view, whatever mesh they are drawn with.
#pragma once

#include "host/look.h"

namespace tidemark {

struct WaveLattice {
    int points;          // along each side of a square around the view
    int extent;          // of that side, model units
    double cell;         // between two points, view heights
    int stepsPerSecond;  // that keep the waves stable
    float damping;       // a step
    float waveSpeed;     // a step
};

// Lengths of the look are shares of the view's height: that of an upright view of 9 : 16 with as many pixels.
WaveLattice latticeFor(const Look& look, int width, int height);

}  // namespace tidemark
