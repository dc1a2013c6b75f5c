// Pictures of the heights, the flow and the density of a frame with ink.
#pragma once

#include <array>
#include <string>

#include "host/look.h"
#include "host/picture.h"
#include "host/water_host.h"

namespace tidemark {

// Returns the file name of picture i: height.png, velocity.png, density.png, result.png.
std::string fieldName(int picture);

// Returns four pictures of the size of `result`, the frame that `host` has just drawn in the current context: the
// heights, with red crests and blue troughs; the flow, with arrows whose length and colour grow with the square root of
// the speed; the ink alone on paper; and `result`.
std::array<Picture, 4> drawFields(const WaterHost& host, const Look& look, const Picture& result);

}  // namespace tidemark
