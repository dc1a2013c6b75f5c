// Files that get their name only when they are complete.
#pragma once

#include <filesystem>
#include <string>

namespace tidemark {

// On failure all functions store the reason in `error`.

// Returns whether a file may be written: it does not exist, or `force` is set.
bool mayWrite(const std::filesystem::path& path, bool force, std::string& error);

// Creates the folder and its parents. An empty path is the current folder.
bool makeFolder(const std::filesystem::path& path, std::string& error);

// Moves a file to its final name. Without `force`, fails if that name exists.
bool rename(const std::filesystem::path& from, const std::filesystem::path& to, bool force, std::string& error);

// Returns a temporary name in the same folder that no other process uses.
std::filesystem::path partOf(const std::filesystem::path& path);

// A temporary file that is deleted unless it was kept.
class NewFile {
public:
    NewFile() = default;
    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    // Creates the empty file part(), for the caller to fill.
    bool make(const std::filesystem::path& path, bool force, std::string& error);
    std::string part() const { return part_.string(); }

    bool keep(std::string& error);

private:
    std::filesystem::path path_, part_;
    bool force_ = false;
};

}  // namespace tidemark
