// Files with values of a look: lines of "key = number" as in look.properties, and comments that begin with #. Values
// that the file does not contain are those of `base`.
#pragma once

#include <iosfwd>
#include <optional>
#include <string>

#include "host/look.h"

namespace tidemark {

// On failure both return nothing and store the reason in `error`, one line that begins with "name:line: ".
std::optional<Look> parseLook(std::istream& text, const std::string& name, std::string& error, const Look& base = {});
std::optional<Look> loadLook(const std::string& path, std::string& error, const Look& base = {});

}  // namespace tidemark
