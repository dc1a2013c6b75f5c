// The program ffmpeg as a child process, which reads pictures of all kinds and writes pictures and videos.
#pragma once

#include <sys/types.h>

#include <cstdio>
#include <string>

#include "host/picture.h"

namespace tidemark {

class Ffmpeg {
public:
    Ffmpeg() = default;
    ~Ffmpeg();  // ends the program if it still runs
    Ffmpeg(const Ffmpeg&) = delete;
    Ffmpeg& operator=(const Ffmpeg&) = delete;

    // The options of both are separated by blanks. On failure these and the next two say why in `error`.

    // Starts the program with the open file `input` as its standard input and its standard output at pipe(). It may
    // use the processor for so many seconds.
    bool startReading(const std::string& options, int input, int mostSeconds, std::string& error);

    // Starts the program with what write() gives it as its input, RGBA frames of this size, to write a file.
    bool startWriting(
        int width, int height, int framesPerSecond, const std::string& options, const std::string& file,
        std::string& error);
    bool write(const Picture& frame, std::string& error);

    // Closes the pipe and waits until the program has ended well.
    bool finish(std::string& error);

    std::FILE* pipe() const { return pipe_; }

    // The first thing that the program complained about, in one line of printable characters; empty for none.
    std::string complaint() const;

private:
    bool start(const std::string& options, const std::string& output, int input, std::string& error);
    int wait();

    pid_t pid_ = -1;
    std::FILE* pipe_ = nullptr;
    std::FILE* messages_ = nullptr;  // its standard error
};

}  // namespace tidemark
