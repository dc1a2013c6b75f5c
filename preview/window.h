// The water in a window, touched with the mouse.
#pragma once

#include <string>

#include "preview/preview.h"

namespace tidemark {

inline constexpr char kWindowKeys[] = "I switches ink, R rain, C clears the ink, Escape or Ctrl-C closes";

// Returns when the window is closed. Takes the pictures, the look, the size, the seed, the ink and the rain of the
// options. On failure says why in `error`. Otherwise `summary` tells what was written, if anything was.
bool runWindow(PreviewOptions options, std::string& summary, std::string& error);

}  // namespace tidemark
