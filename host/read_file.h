#pragma once

#include <cstddef>
#include <optional>
#include <string>

namespace tidemark {

// Returns the content of a regular file of at most `mostBytes`; devices and pipes, which may never end, are refused. On
// failure stores in `error` why `what`, for example "the look", cannot be read.
std::optional<std::string> readFile(
    const std::string& path, const std::string& what, std::size_t mostBytes, std::string& error);

}  // namespace tidemark
