// Read access to the engine's state, for front ends that show what is behind a frame. Link the library's objects, not
// the shared library, which hides these symbols.
#pragma once

#include <vector>

namespace tidemark {

struct EngineView {
    // The flow, rows from the bottom: the velocity's x and y for each cell, y upwards.
    std::vector<float> velocity;
    int gridWidth, gridHeight;

    // The ink's density, rows from the bottom, 0 to 127.
    std::vector<float> density;
    int inkWidth, inkHeight;

    // The amount that one unit of density adds to the divisors of red, green and blue.
    float tint[3];
};

// Returns the engine's state after the last frame. Requires the context to be current and a set-up with ink. Leaves
// framebuffer 0 bound.
EngineView lookIntoEngine();

}  // namespace tidemark
