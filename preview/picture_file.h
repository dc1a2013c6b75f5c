// Pictures in files.
#pragma once

#include <optional>
#include <string>

#include "host/picture.h"

namespace tidemark {

// The size of the largest phone cameras' photos. Reading one needs a few times four bytes for each pixel.
constexpr int kMostPixels = 200'000'000;

// A picture of any kind that ffmpeg reads, turned as the camera was held where a JPEG tells, over white where it is
// transparent. Of one that moves, the first frame. On failure, or for a picture of more than `mostPixels` pixels, says
// why in `error`. Says on standard error what is wrong with a damaged picture.
std::optional<Picture> loadPicture(const std::string& path, std::string& error, int mostPixels = kMostPixels);

// How ffmpeg writes PNGs.
constexpr char kPng[] = "-c:v png -pred mixed -pix_fmt rgb24";

// Writes a PNG. On failure says why in `error`.
bool savePicture(const Picture& picture, const std::string& path, std::string& error);

}  // namespace tidemark
