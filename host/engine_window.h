// The one window into the engine, for faces that show what lies behind a frame. It needs the library's objects: the
// shared library hides what it looks at.
#pragma once

#include <vector>

namespace tidemark {

struct EngineView {
    // The flow, rows from the bottom: x and y of each cell, y upwards.
    std::vector<float> velocity;
    int gridWidth, gridHeight;

    // The ink, rows from the bottom, 0 to 127.
    std::vector<float> density;
    int inkWidth, inkHeight;

    // One unit of density adds this to the divisor of red, green and blue.
    float tint[3];
};

// The engine's state after the last frame. Needs the context current and a set-up with ink; leaves framebuffer 0 bound.
EngineView lookIntoEngine();

}  // namespace tidemark
