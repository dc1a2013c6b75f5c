// Reads and writes picture files.
#pragma once

#include <optional>
#include <string>

#include "host/picture.h"

namespace tidemark {

// 200 megapixels, the largest photos of phones. Decoding needs several times four bytes per pixel.
constexpr int kMostPixels = 200'000'000;

// Decodes a picture in any format that ffmpeg supports: the first frame of an animation, rotated according to a JPEG's
// EXIF orientation, over white where it is transparent. On failure, or if it has more than `mostPixels` pixels, returns
// nothing and stores the reason in `error`. Reports damage to standard error.
std::optional<Picture> loadPicture(const std::string& path, std::string& error, int mostPixels = kMostPixels);

// ffmpeg options for PNG.
constexpr char kPng[] = "-c:v png -pred mixed -pix_fmt rgb24";

// Writes a PNG. On failure returns false and stores the reason in `error`.
bool savePicture(const Picture& picture, const std::string& path, std::string& error);

}  // namespace tidemark
