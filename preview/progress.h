// A progress bar on standard error for runs that take longer than a second; nothing where nobody watches.
#pragma once

#include <chrono>

class Progress {
public:
    explicit Progress(int frames);
    ~Progress();

    void show(int framesDone);

private:
    int frames_;
    bool watched_;
    bool shown_ = false;
    std::chrono::steady_clock::time_point start_ = std::chrono::steady_clock::now();
};
