// Prepares the pictures, the look and the script that the options of a run name.
#pragma once

#include <optional>
#include <string>

#include "host/look.h"
#include "host/picture.h"
#include "preview/preview.h"

namespace tidemark {

// On failure says why in `error`.
std::optional<Pictures> choosePictures(const PreviewOptions& options, std::string& error);

// Makes a picture that is larger than the current context's driver takes smaller, and says so on standard error.
void fitToDriver(const std::string& file, Picture& picture);

// Says on standard error what it has to change. On failure says why in `error`.
std::optional<Look> chooseLook(const PreviewOptions& options, std::string& error);

}  // namespace tidemark
