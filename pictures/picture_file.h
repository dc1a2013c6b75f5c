// Pictures from PNG and JPEG files.
#pragma once

#include <optional>
#include <string>

#include "host/picture.h"

// What the largest phone cameras take. Reading one needs a few times four bytes for each pixel.
constexpr int kMostPixels = 200'000'000;

// On failure, or for a picture of more than `mostPixels` pixels, says why in `error`.
std::optional<Picture> loadPicture(const std::string& path, std::string& error, int mostPixels = kMostPixels);

// The picture, made smaller in its own proportions where a side is longer than `longestSide` pixels.
Picture fitPicture(Picture picture, int longestSide);
