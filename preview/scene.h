// Loads the pictures and the look that the options select.
#pragma once

#include <optional>
#include <string>

#include "host/look.h"
#include "host/picture.h"
#include "preview/preview.h"

namespace tidemark {

// On failure returns nothing and stores the reason in `error`.
std::optional<Pictures> choosePictures(const PreviewOptions& options, std::string& error);

// Scales a picture down to the driver's texture limit, and reports that on standard error.
void fitToDriver(const std::string& file, Picture& picture);

// Reports changes to the ink's colour on standard error. On failure returns nothing and stores the reason in `error`.
std::optional<Look> chooseLook(const PreviewOptions& options, std::string& error);

}  // namespace tidemark
