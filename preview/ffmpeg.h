// Runs ffmpeg as a child process to decode pictures and to encode pictures and videos.
#pragma once

#include <sys/types.h>

#include <cstdio>
#include <string>

#include "host/picture.h"

namespace tidemark {

class Ffmpeg {
public:
    Ffmpeg() = default;
    ~Ffmpeg();  // kills ffmpeg if it still runs
    Ffmpeg(const Ffmpeg&) = delete;
    Ffmpeg& operator=(const Ffmpeg&) = delete;

    // `options` are separated by spaces. On failure the functions return false and store the reason in `error`.

    // Starts ffmpeg with the open file `input` as standard input and its standard output at pipe(). Its processor time
    // is limited to `mostSeconds`.
    bool startReading(const std::string& options, int input, int mostSeconds, std::string& error);

    // Starts ffmpeg to encode `file` from the frames passed to write(), RGBA of the given size.
    bool startWriting(
        int width, int height, int framesPerSecond, const std::string& options, const std::string& file,
        std::string& error);
    bool write(const Picture& frame, std::string& error);

    // Closes the pipe and waits for ffmpeg to succeed.
    bool finish(std::string& error);

    std::FILE* pipe() const { return pipe_; }

    // Returns ffmpeg's first message as one line of printable characters, or an empty string.
    std::string complaint() const;

private:
    bool start(const std::string& options, const std::string& output, int input, std::string& error);
    int wait();

    pid_t pid_ = -1;
    std::FILE* pipe_ = nullptr;
    std::FILE* messages_ = nullptr;  // ffmpeg's standard error
};

}  // namespace tidemark
