#include <stb/stb_image_write.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <deque>
#include <filesystem>
#include <fstream>
#include <future>
#include <thread>

#include "preview/frame_sink.h"
#include "preview/new_directories.h"

namespace fs = std::filesystem;

namespace {

// An empty text when all went well.
std::string writePng(const fs::path& path, const Picture& frame) {
    // stb's own file output does not tell when the disk is full.
    std::ofstream file(path, std::ios::binary);
    const auto append = [](void* stream, void* bytes, int count) {
        static_cast<std::ofstream*>(stream)->write(static_cast<const char*>(bytes), count);
    };
    const int done = stbi_write_png_to_func(append, &file, frame.width, frame.height, 4, frame.rgba.data(), 0);
    file.close();
    return done && file ? "" : "cannot write " + path.string() + ": " + std::strerror(errno);
}

class PngSink : public FrameSink {
public:
    explicit PngSink(fs::path directory) : directory_(std::move(directory)) {}

    ~PngSink() override {
        writes_.clear();  // waits for them
        std::error_code ignored;
        while (frames_ > 0) fs::remove(framePath(--frames_), ignored);
    }

    bool open(std::string& error) { return newDirectories_.make(directory_, error); }

    // Packing a PNG takes longer than drawing the frame, so several are packed at the same time.
    bool write(const Picture& frame, std::string& error) override {
        while (writes_.size() > std::thread::hardware_concurrency()) {
            if (!finishOne(error)) return false;
        }
        writes_.push_back(std::async(std::launch::async, writePng, framePath(frames_++), frame));
        return true;
    }

    bool finish(std::string& error) override {
        while (!writes_.empty()) {
            if (!finishOne(error)) return false;
        }
        frames_ = 0;
        newDirectories_.keep();
        return true;
    }

private:
    bool finishOne(std::string& error) {
        error = writes_.front().get();
        writes_.pop_front();
        return error.empty();
    }

    fs::path framePath(int frame) const {
        char name[32];
        std::snprintf(name, sizeof name, "frame-%04d.png", frame);
        return directory_ / name;
    }

    NewDirectories newDirectories_;
    fs::path directory_;
    int frames_ = 0;  // begun and not kept yet
    std::deque<std::future<std::string>> writes_;
};

}  // namespace

std::unique_ptr<FrameSink> openPngSink(const std::string& directory, std::string& error) {
    auto sink = std::make_unique<PngSink>(directory);
    if (!sink->open(error)) return nullptr;
    return sink;
}
