// What the options of a run ask for, made ready.
#pragma once

#include <optional>
#include <string>

#include "host/look.h"
#include "host/picture.h"
#include "preview/preview.h"

// On failure says why in `error`.
std::optional<Pictures> choosePictures(const PreviewOptions& options, std::string& error);

// Makes what is larger than the current context's driver takes smaller, and says so on standard error.
void fitToDriver(const PreviewOptions& options, Pictures& pictures);

// On failure says why in `error`.
std::optional<Look> chooseLook(const PreviewOptions& options, std::string& error);
