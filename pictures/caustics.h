// The net of light that a rippled surface focuses on the ground below.
#pragma once

#include <vector>

namespace tidemark {

// A width x height map of brightness, 1 on average, rows from the top. `cell` is about the size of a mesh of the
// net in pixels; equal seeds give equal nets.
std::vector<float> causticNet(int width, int height, float cell, unsigned seed);

}  // namespace tidemark
