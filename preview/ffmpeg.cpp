#include "preview/ffmpeg.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <iterator>
#include <sstream>
#include <utility>
#include <vector>

namespace tidemark {

Ffmpeg::~Ffmpeg() {
    if (pid_ > 0) kill(pid_, SIGKILL);
    wait();
    if (messages_) std::fclose(messages_);
}

// With a file as input, the pipe is ffmpeg's output; without, it is ffmpeg's input.
bool Ffmpeg::start(const std::string& options, const std::string& output, int input, std::string& error) {
    const bool reads = input >= 0;
    int ends[2];
    messages_ = std::tmpfile();
    if (!messages_ || pipe2(ends, O_CLOEXEC) != 0) {
        error = std::string("cannot start ffmpeg: ") + std::strerror(errno);
        return false;
    }
    const auto [near, far] = reads ? std::pair(ends[0], ends[1]) : std::pair(ends[1], ends[0]);
    pipe_ = fdopen(near, reads ? "r" : "w");
    // If ffmpeg ends early, write() must report it instead of SIGPIPE ending this program.
    std::signal(SIGPIPE, SIG_IGN);

    std::istringstream words("ffmpeg -nostdin -hide_banner -loglevel error " + options);
    std::vector<std::string> arguments{std::istream_iterator<std::string>(words), {}};
    arguments.push_back(output);
    std::vector<char*> pointers;
    pointers.reserve(arguments.size() + 1);
    for (std::string& argument : arguments) pointers.push_back(argument.data());
    pointers.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, reads ? input : far, STDIN_FILENO);
    if (reads) {
        posix_spawn_file_actions_adddup2(&actions, far, STDOUT_FILENO);
    } else {
        posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    }
    posix_spawn_file_actions_adddup2(&actions, fileno(messages_), STDERR_FILENO);
    // In its own process group ffmpeg does not receive Ctrl-C from the terminal, so that this program can finish the
    // clip.
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETPGROUP);
    const int problem = posix_spawnp(&pid_, pointers[0], &actions, &attributes, pointers.data(), environ);
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
    close(far);
    if (problem == 0) return true;
    pid_ = -1;
    error = problem == ENOENT ? "ffmpeg is missing: install Debian's package ffmpeg"
                              : std::string("cannot start ffmpeg: ") + std::strerror(problem);
    return false;
}

bool Ffmpeg::startReading(const std::string& options, int input, int mostSeconds, std::string& error) {
    if (!start(options, "pipe:1", input, error)) return false;
    const rlimit limit = {static_cast<rlim_t>(mostSeconds), static_cast<rlim_t>(mostSeconds)};
    prlimit(pid_, RLIMIT_CPU, &limit, nullptr);
    return true;
}

bool Ffmpeg::startWriting(
    int width, int height, int framesPerSecond, const std::string& options, const std::string& file,
    std::string& error) {
    const std::string frames = "-y -f rawvideo -pix_fmt rgba -video_size " + std::to_string(width) + "x" +
                               std::to_string(height) + " -framerate " + std::to_string(framesPerSecond) +
                               " -i pipe:0 ";
    // Leave out the creation time and the encoder's version, so that equal frames give equal files.
    return start(frames + options + " -fflags +bitexact -flags:v +bitexact", "file:" + file, -1, error);
}

bool Ffmpeg::write(const Picture& frame, std::string& error) {
    if (std::fwrite(frame.rgba.data(), 1, frame.rgba.size(), pipe_) == frame.rgba.size()) return true;
    if (finish(error)) error = "ffmpeg ended early";
    return false;
}

bool Ffmpeg::finish(std::string& error) {
    const int status = wait();
    if (status == 0) return true;
    std::string reason = complaint();
    if (WIFSIGNALED(status) && WTERMSIG(status) == SIGKILL) reason = "it takes too long";
    if (WIFSIGNALED(status) && reason.empty()) reason = strsignal(WTERMSIG(status));
    error = "ffmpeg failed" + (reason.empty() ? "" : ": " + reason);
    return false;
}

std::string Ffmpeg::complaint() const {
    std::rewind(messages_);
    char line[512];
    if (!std::fgets(line, sizeof line, messages_)) return "";
    std::string text = line;
    while (!text.empty() && text.back() == '\n') text.pop_back();
    // Skip the prefix with ffmpeg's component and an address: "[png @ 0x55e0a8] ".
    while (text.starts_with('[') && text.find("] ") != text.npos) text.erase(0, text.find("] ") + 2);
    if (text.starts_with("pipe:0: ")) text.erase(0, 8);
    text.resize(std::min(text.size(), text.find(", see the documentation")));
    // ffmpeg may quote bytes of the file, which could control a terminal.
    std::replace_if(
        text.begin(), text.end(), [](char c) { return c < ' ' || c > '~'; }, '?');
    return text;
}

// Closes the pipe, which ends ffmpeg, and returns its exit status.
int Ffmpeg::wait() {
    if (pipe_) std::fclose(pipe_);
    pipe_ = nullptr;
    int status = 0;
    if (pid_ > 0) {
        while (waitpid(pid_, &status, 0) < 0 && errno == EINTR) continue;
    }
    pid_ = -1;
    return status;
}

}  // namespace tidemark
