// The moving water: a damped wave equation over one height and one speed per vertex.
#pragma once

// The vertices that a step updates: x in [xStart, xEnd) along a stride, y in [yStart, yEnd) across strides.
// The vertices around the region are read and never written, so they hold the water's edge in place; the arrays
// must reach at least one vertex beyond the region on every side.
struct WaveRegion {
    int xStart;
    int yStart;
    int xEnd;
    int yEnd;
    int stride;  // floats from one y to the next
};

// One time step, explicit in time: v <- damping * (v + waveSpeed * laplacian(h)); h <- clamp(h + v, -100, 100);
// h <- h + k * laplacian(h), k being 0.068 for a damping of exactly 0.94f and 0.018 otherwise. With `checkCalm`
// returns whether every updated speed lies within +-0.009 (a speed that is not a number counts as calm), else true.
bool stepWaves(
    float* velocity, float* height, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed);
