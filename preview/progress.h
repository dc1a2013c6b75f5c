// Shows the progress of a run on standard error, if that is a terminal.
#pragma once

#include <chrono>
#include <string>

namespace tidemark {

class Progress {
public:
    // Says what comes before the first frame, which takes a while in a large view.
    explicit Progress(const std::string& beginning);
    ~Progress();

    // A bar, ten times a second.
    void show(int framesDone, int frames);

private:
    bool watched_;
    bool shown_ = false;
    std::chrono::steady_clock::time_point next_ = {};
};

}  // namespace tidemark
