// The water's mesh: a grid in the model plane z = 0, its vertices stored column by column from the left, each
// column from the top down. Both counts must be the same number N, 2 to 256 (indices have 16 bits).
#pragma once

#include <cstdint>

// Writes x, y, z of the first `vertexCount` vertices: 3 * vertexCount floats, in model units around (0, 0).
void fillPositions(
    float* positions, int vertexCount, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
    int numDetailsHeight);

// Writes two counter-clockwise triangles a cell: 6 * (N - 1) * (N - 1) vertex numbers, to be read as unsigned.
void fillIndices(std::int16_t* indices, int numDetailsWidth, int numDetailsHeight);
