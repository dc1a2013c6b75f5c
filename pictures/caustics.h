// Caustics: the net of light that a rippled surface focuses on the ground.
#pragma once

#include <vector>

namespace tidemark {

// Returns a map of brightness with a mean of 1, width x height floats, rows from the top. `cell` is the approximate
// size of the net's meshes in pixels. The same seed gives the same net.
std::vector<float> causticNet(int width, int height, float cell, unsigned seed);

}  // namespace tidemark
