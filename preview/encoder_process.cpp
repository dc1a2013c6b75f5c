#include "preview/encoder_process.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstring>

bool EncoderProcess::start(const std::vector<std::string>& command, std::string& error) {
    name_ = command.front();
    int ends[2];
    messages_ = std::tmpfile();
    if (!messages_ || pipe2(ends, O_CLOEXEC) != 0) {
        error = "cannot start " + name_ + ": " + std::strerror(errno);
        return false;
    }
    input_ = ends[1];
    // A program that ends early is reported by write, not by a signal.
    std::signal(SIGPIPE, SIG_IGN);

    std::vector<char*> arguments;
    arguments.reserve(command.size() + 1);
    for (const std::string& argument : command) arguments.push_back(const_cast<char*>(argument.c_str()));
    arguments.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, ends[0], STDIN_FILENO);
    posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    posix_spawn_file_actions_adddup2(&actions, fileno(messages_), STDERR_FILENO);
    const int problem = posix_spawnp(&pid_, arguments[0], &actions, nullptr, arguments.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    ::close(ends[0]);
    if (problem != 0) {
        pid_ = -1;
        error = problem == ENOENT ? name_ + " is missing: install Debian's package " + name_
                                  : "cannot start " + name_ + ": " + std::strerror(problem);
        return false;
    }
    return true;
}

bool EncoderProcess::write(const void* bytes, std::size_t count, std::string& error) {
    const char* next = static_cast<const char*>(bytes);
    while (count > 0) {
        const ssize_t written = ::write(input_, next, count);
        if (written < 0 && errno == EINTR) continue;
        if (written < 0) {
            finish(error);
            error = name_ + " ended early" + complaint();
            return false;
        }
        next += written;
        count -= static_cast<std::size_t>(written);
    }
    return true;
}

bool EncoderProcess::finish(std::string& error) {
    if (wait() == 0) return true;
    error = name_ + " failed" + complaint();
    return false;
}

void EncoderProcess::kill() {
    if (pid_ > 0) ::kill(pid_, SIGKILL);
    wait();
    if (messages_) std::fclose(messages_);
    messages_ = nullptr;
}

// The last line that the program had to say.
std::string EncoderProcess::complaint() {
    std::rewind(messages_);
    std::string last;
    char line[512];
    while (std::fgets(line, sizeof line, messages_)) last = line;
    while (!last.empty() && last.back() == '\n') last.pop_back();
    return last.empty() ? "" : ": " + last;
}

// Closes the input, so that the program ends, and returns 0 if it ended well.
int EncoderProcess::wait() {
    if (input_ >= 0) ::close(input_);
    input_ = -1;
    int status = 0;
    if (pid_ > 0) {
        while (waitpid(pid_, &status, 0) < 0 && errno == EINTR) continue;
    }
    pid_ = -1;
    return status;
}
