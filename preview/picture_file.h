// Pictures from PNG and JPEG files.
#pragma once

#include <optional>
#include <string>

#include "host/picture.h"

// On failure says why in `error`.
std::optional<Picture> loadPicture(const std::string& path, std::string& error);

// The picture, made smaller in its own proportions where a side is longer than `longestSide` pixels.
Picture fitPicture(Picture picture, int longestSide);
