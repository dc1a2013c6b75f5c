// A program that is fed through its standard input.
#pragma once

#include <sys/types.h>

#include <cstddef>
#include <cstdio>
#include <string>
#include <vector>

class EncoderProcess {
public:
    EncoderProcess() = default;
    ~EncoderProcess() { kill(); }
    EncoderProcess(const EncoderProcess&) = delete;
    EncoderProcess& operator=(const EncoderProcess&) = delete;

    // Starts the program, looked for in PATH, without a shell in between. This and the next two say why in `error` on
    // failure.
    bool start(const std::vector<std::string>& command, std::string& error);
    bool write(const void* bytes, std::size_t count, std::string& error);

    // Closes the program's input and waits until it has ended well.
    bool finish(std::string& error);

    // Ends the program if it still runs.
    void kill();

private:
    std::string complaint();
    int wait();

    std::string name_;
    pid_t pid_ = -1;
    int input_ = -1;
    std::FILE* messages_ = nullptr;  // what the program writes to its standard error
};
