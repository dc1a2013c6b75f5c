// What the command line says in words of its own: sizes and colours. On failure both say why in `error`.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "host/view_size.h"

// "540x960"; each side 1 to 8192.
std::optional<Size> parseSize(std::string_view text, std::string& error);

struct InkColor {
    float red, green, blue;
};

// "#rrggbb", each channel brought into the range that the ink can show.
std::optional<InkColor> parseInkColor(std::string_view text, std::string& error);
