// Records the log lines during its lifetime, as "I text" and "E text".
#pragma once

#include <android/log.h>

#include <string>
#include <utility>
#include <vector>

class LogRecorder {
public:
    LogRecorder() {
        lines.clear();
        __android_log_set_logger([](const __android_log_message* message) {
            lines.push_back((message->priority == ANDROID_LOG_ERROR ? "E " : "I ") + std::string(message->message));
        });
    }
    ~LogRecorder() { __android_log_set_logger(__android_log_stderr_logger); }

    // Returns the lines since the last call.
    std::vector<std::string> take() { return std::exchange(lines, {}); }

private:
    static inline std::vector<std::string> lines;
};
