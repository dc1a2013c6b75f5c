// Looks as files: "key = number" lines as in look.properties, and comments that start with a #. What a file does not
// name keeps the value of `base`.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>

#include "host/look.h"

namespace tidemark {

// On failure says why in `error`, in one line that starts with "name:line: ".
std::optional<Look> parseLook(std::istream& text, const std::string& name, std::string& error, const Look& base = {});
std::optional<Look> loadLook(const std::string& path, std::string& error, const Look& base = {});

}  // namespace tidemark
