// Files that appear under their names once they are whole.
#pragma once

#include <filesystem>
#include <string>

namespace tidemark {

// All of these say why in `error` on failure.

// Whether a file may be written: there is none of that name, or it may be overwritten.
bool mayWrite(const std::filesystem::path& path, bool force, std::string& error);

// Makes the folder and what is missing above it; an empty path is the current folder.
bool makeFolder(const std::filesystem::path& path, std::string& error);

// Gives a file its name. Without `force` a file that has that name by now stays, and this fails.
bool rename(const std::filesystem::path& from, const std::filesystem::path& to, bool force, std::string& error);

// A name beside this one that no other run uses.
std::filesystem::path partOf(const std::filesystem::path& path);

// A file of which nothing is left when it is destroyed before it was kept.
class NewFile {
public:
    NewFile() = default;
    ~NewFile();
    NewFile(const NewFile&) = delete;
    NewFile& operator=(const NewFile&) = delete;

    // Makes an empty file, to be filled under the name part().
    bool make(const std::filesystem::path& path, bool force, std::string& error);
    std::string part() const { return part_.string(); }

    bool keep(std::string& error);

private:
    std::filesystem::path path_, part_;
    bool force_ = false;
};

}  // namespace tidemark
