// Draws the heights, the flow and the density behind a frame with ink.
#pragma once

#include <array>
#include <string>

#include "host/look.h"
#include "host/picture.h"
#include "host/water_host.h"

namespace tidemark {

// The pictures as files: height.png, velocity.png, density.png and result.png.
std::string insideName(int picture);

// Four pictures of the size of `result`, the frame that `host` has just drawn in the current context: the water's
// heights, crests red and troughs blue; the flow, arrows whose length and colour grow with the square root of the
// speed; the ink alone, on paper; and the frame.
std::array<Picture, 4> drawInside(const WaterHost& host, const Look& look, const Picture& result);

}  // namespace tidemark
