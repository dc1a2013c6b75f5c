#include "preview/new_file.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstring>

namespace tidemark {

namespace fs = std::filesystem;

namespace {

bool cannotWrite(const fs::path& path, std::string& error) {
    error = "cannot write " + path.string() + ": " + std::strerror(errno);
    return false;
}

}  // namespace

bool mayWrite(const fs::path& path, bool force, std::string& error) {
    std::error_code ignored;
    const fs::file_status status = fs::symlink_status(path, ignored);
    if (!fs::exists(status) || (force && !fs::is_directory(status))) return true;
    error = path.string() + (fs::is_directory(status) ? " is a folder" : " exists already; --force overwrites it");
    return false;
}

bool makeFolder(const fs::path& path, std::string& error) {
    std::error_code problem;
    if (path.empty() || fs::create_directories(path, problem) || !problem) return true;
    error = "cannot make the folder " + path.string() + ": " + problem.message();
    return false;
}

bool rename(const fs::path& from, const fs::path& to, bool force, std::string& error) {
    if (renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), force ? 0 : RENAME_NOREPLACE) == 0) return true;
    if (errno == EEXIST) return mayWrite(to, force, error);
    // Some file systems do not support RENAME_NOREPLACE.
    if (errno != EINVAL) return cannotWrite(to, error);
    if (!mayWrite(to, force, error)) return false;
    return std::rename(from.c_str(), to.c_str()) == 0 || cannotWrite(to, error);
}

fs::path partOf(const fs::path& path) {
    return path.string() + ".part-" + std::to_string(getpid());
}

NewFile::~NewFile() {
    std::error_code ignored;
    if (!part_.empty()) fs::remove(part_, ignored);
}

bool NewFile::make(const fs::path& path, bool force, std::string& error) {
    if (!mayWrite(path, force, error) || !makeFolder(path.parent_path(), error)) return false;
    const fs::path part = partOf(path);
    const int file = open(part.c_str(), O_CREAT | O_EXCL | O_WRONLY | O_CLOEXEC, 0666);
    if (file < 0) return cannotWrite(path, error);
    close(file);
    path_ = path;
    part_ = part;
    force_ = force;
    return true;
}

bool NewFile::keep(std::string& error) {
    if (!rename(part_, path_, force_, error)) return false;
    part_.clear();
    return true;
}

}  // namespace tidemark
