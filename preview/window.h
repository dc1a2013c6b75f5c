// A window with the water, touched with the mouse.
#pragma once

#include <string>

#include "preview/preview.h"

namespace tidemark {

inline constexpr char kWindowKeys[] = "I switches ink, R rain, C clears the ink, Escape or Ctrl-C closes";

// Runs until the window is closed. Uses the options for pictures, look, size, seed, ink and rain. On failure returns
// false and stores the reason in `error`. Otherwise stores in `summary` which file was written, if any.
bool runWindow(PreviewOptions options, std::string& summary, std::string& error);

}  // namespace tidemark
