// The water in a window: the mouse touches it, I and R switch ink and rain, C clears the ink, Escape closes.
#pragma once

#include <string>

#include "preview/preview.h"

// Returns when the window is closed. Takes the pictures, the look, the size, the seed, the ink and the rain of the
// options. On failure says why in `error`.
bool runWindow(const PreviewOptions& options, std::string& error);
