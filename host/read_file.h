#pragma once

#include <cstddef>
#include <optional>
#include <string>

namespace tidemark {

// The bytes of a regular file of at most `mostBytes`: a device or a pipe might never end. On failure says in `error`
// why `what`, for example "the look", cannot be read.
std::optional<std::string> readFile(
    const std::string& path, const std::string& what, std::size_t mostBytes, std::string& error);

}  // namespace tidemark
