// Looks as files: "key = number" lines as in look.properties, and comments that start with a #. What a file does not
// name keeps its default.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>

#include "host/look.h"

// On failure says why in `error`, in one line that starts with "name:line: ".
std::optional<Look> parseLook(std::istream& text, const std::string& name, std::string& error);
std::optional<Look> loadLook(const std::string& path, std::string& error);
