#include "host/read_file.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <fstream>

namespace tidemark {

std::optional<std::string> readFile(
    const std::string& path, const std::string& what, std::size_t mostBytes, std::string& error) {
    const auto fail = [&](const std::string& reason) {
        error = "cannot read " + what + " " + path + ": " + reason;
        return std::nullopt;
    };
    struct stat status;
    if (stat(path.c_str(), &status) != 0) return fail(std::strerror(errno));
    // Checked before the file is opened, because opening a pipe blocks until its other end is open.
    if (!S_ISREG(status.st_mode)) return fail("it is not a regular file");
    if (static_cast<std::uintmax_t>(status.st_size) > mostBytes) {
        return fail("it has more than " + std::to_string(mostBytes) + " bytes");
    }
    std::ifstream file(path, std::ios::binary);
    if (!file) return fail(std::strerror(errno));
    std::string content(static_cast<std::size_t>(status.st_size), '\0');
    file.read(content.data(), static_cast<std::streamsize>(content.size()));
    content.resize(static_cast<std::size_t>(file.gcount()));
    return content;
}

}  // namespace tidemark
