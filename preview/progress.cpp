#include "preview/progress.h"

#include <unistd.h>

#include <cstdio>

namespace tidemark {

Progress::Progress(const std::string& beginning) : watched_(isatty(STDERR_FILENO) != 0) {
    if (watched_) std::fprintf(stderr, "%s ...\n", beginning.c_str());
}

Progress::~Progress() {
    // Clears the line for the next message.
    if (shown_) std::fputs("\r\033[K", stderr);
}

void Progress::show(int framesDone, int frames) {
    if (!watched_ || std::chrono::steady_clock::now() < next_) return;
    next_ = std::chrono::steady_clock::now() + std::chrono::milliseconds(100);
    constexpr int kCells = 40;
    const auto filled = static_cast<std::size_t>(static_cast<long long>(framesDone) * kCells / frames);
    const std::string bar = std::string(filled, '#') + std::string(kCells - filled, '.');
    std::fprintf(stderr, "\r[%s] %d of %d frames", bar.c_str(), framesDone, frames);
    shown_ = true;
}

}  // namespace tidemark
