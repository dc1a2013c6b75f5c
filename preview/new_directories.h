// Directories made for the output, which go again, as far as they are empty, unless they are kept.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

class NewDirectories {
public:
    ~NewDirectories();

    // Makes `path` and what is missing above it; an empty path is the current directory. On failure says why in
    // `error`.
    bool make(const std::filesystem::path& path, std::string& error);
    void keep() { made_.clear(); }

private:
    std::vector<std::filesystem::path> made_;  // outermost first
};
