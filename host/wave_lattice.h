// The lattice on which the waves are computed. Its cell size is a fraction of the view and its step a fraction of a
// second, so that waves look and move the same for any view and drawn mesh.
#pragma once

#include "host/look.h"

namespace tidemark {

struct WaveLattice {
    int points;          // along each side of a square around the view
    int extent;          // length of that side in model units
    double cell;         // distance of two points in view heights
    int stepsPerSecond;  // at least the look's, so that the waves are stable
    float damping;       // factor per step
    float waveSpeed;     // factor per step
};

// The look's lengths are relative to the view's height. For other proportions, this is the height of a 9 : 16 view with
// the same number of pixels.
WaveLattice latticeFor(const Look& look, int width, int height);

}  // namespace tidemark
