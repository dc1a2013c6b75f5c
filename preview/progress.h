// Shows the progress of a run on standard error, if that is a terminal.
#pragma once

#include <chrono>
#include <string>

namespace tidemark {

class Progress {
public:
    // Shows a message until the first frame, which can take seconds for a large view.
    explicit Progress(const std::string& beginning);
    ~Progress();

    // Draws a bar, at most ten times a second.
    void show(int framesDone, int frames);

private:
    bool watched_;
    bool shown_ = false;
    std::chrono::steady_clock::time_point next_ = {};
};

}  // namespace tidemark
