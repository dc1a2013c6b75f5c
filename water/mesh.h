// The water's mesh: a grid of N x N vertices in the model plane z = 0, stored column by column from the left, each
// column from top to bottom. N is numDetailsWidth and numDetailsHeight, 2 to 256 because indices have 16 bits.
#pragma once

#include <cstdint>

// Writes x, y, z of the first `vertexCount` vertices in model units, centred on (0, 0): 3 * vertexCount floats.
void fillPositions(
    float* positions, int vertexCount, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
    int numDetailsHeight);

// Writes two counter-clockwise triangles per cell: 6 * (N - 1) * (N - 1) vertex numbers, stored as unsigned 16-bit
// values.
void fillIndices(std::int16_t* indices, int numDetailsWidth, int numDetailsHeight);
