#include "preview/progress.h"

#include <unistd.h>

#include <cstdio>
#include <string>

Progress::Progress(int frames) : frames_(frames), watched_(isatty(STDERR_FILENO) != 0) {}

Progress::~Progress() {
    // Wipes the line, so that what comes next starts on a clean one.
    if (shown_) std::fputs("\r\033[K", stderr);
}

void Progress::show(int framesDone) {
    if (!watched_ || std::chrono::steady_clock::now() - start_ < std::chrono::seconds(1)) return;
    constexpr int kCells = 40;
    const auto filled = static_cast<std::size_t>(static_cast<long long>(framesDone) * kCells / frames_);
    const std::string bar = std::string(filled, '#') + std::string(kCells - filled, '.');
    std::fprintf(stderr, "\r[%s] %d of %d frames", bar.c_str(), framesDone, frames_);
    shown_ = true;
}
