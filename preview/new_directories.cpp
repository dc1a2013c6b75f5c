#include "preview/new_directories.h"

#include <unistd.h>

#include <cerrno>
#include <cstring>

namespace fs = std::filesystem;

NewDirectories::~NewDirectories() {
    std::error_code ignored;
    for (; !made_.empty(); made_.pop_back()) fs::remove(made_.back(), ignored);
}

bool NewDirectories::make(const fs::path& path, std::string& error) {
    fs::path directory;
    for (const fs::path& part : path) {
        directory /= part;
        std::error_code problem;
        if (fs::create_directory(directory, problem)) made_.push_back(directory);
        if (problem) {
            error = "cannot make the directory " + directory.string() + ": " + problem.message();
            return false;
        }
    }
    if (access(path.empty() ? "." : path.c_str(), W_OK | X_OK) != 0) {
        error = "cannot write to the directory " + path.string() + ": " + std::strerror(errno);
        return false;
    }
    return true;
}
