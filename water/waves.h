// Steps a damped wave equation over one height and one velocity per vertex.
#pragma once

// The vertices that a step updates: x in [xStart, xEnd), y in [yStart, yEnd), element y * stride + x. The vertices
// around the region are fixed boundary values: they are read and never written. The arrays must contain them on every
// side.
struct WaveRegion {
    int xStart;
    int yStart;
    int xEnd;
    int yEnd;
    int stride;  // floats from one y to the next
};

// Computes one explicit time step:
//   v = damping * (v + waveSpeed * laplacian(h))
//   h = clamp(h + v, -100, 100)
//   h = h + k * laplacian(h), with k = 0.068 for a damping of exactly 0.94f, else 0.018
// With `checkCalm` returns whether |v| <= 0.009 for every updated vertex, else true. NaN counts as calm.
bool stepWaves(
    float* velocity, float* height, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed);
