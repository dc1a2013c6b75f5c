#include <stb/stb_image_write.h>

#include <cerrno>
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

bool writePng(const fs::path& path, const Picture& frame, std::string& error) {
    // stb's own file output does not tell when the disk is full.
    std::ofstream file(path, std::ios::binary);
    const auto append = [](void* stream, void* bytes, int count) {
        static_cast<std::ofstream*>(stream)->write(static_cast<const char*>(bytes), count);
    };
    const int done = stbi_write_png_to_func(append, &file, frame.width, frame.height, 4, frame.rgba.data(), 0);
    file.close();
    if (done && file) return true;
    error = "cannot write " + path.string() + ": " + std::strerror(errno);
    return false;
}

class PngSink : public FrameSink {
public:
    PngSink(fs::path directory, std::string (*nameOf)(int)) : directory_(std::move(directory)), nameOf_(nameOf) {}

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
        Write& next = writes_.emplace_back();
        next.done = std::async(std::launch::async, [&next, path = framePath(frames_++), frame] {
            return writePng(path, frame, next.error);
        });
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
    struct Write {
        std::string error;
        std::future<bool> done;  // waits, when it goes, for the write that may still put an error beside it
    };

    bool finishOne(std::string& error) {
        const bool written = writes_.front().done.get();
        if (!written) error = writes_.front().error;
        writes_.pop_front();
        return written;
    }

    fs::path framePath(int frame) const { return directory_ / nameOf_(frame); }

    NewDirectories newDirectories_;
    fs::path directory_;
    std::string (*nameOf_)(int frame);
    int frames_ = 0;  // begun and not kept yet
    std::deque<Write> writes_;
};

}  // namespace

std::unique_ptr<FrameSink> openPngSink(const std::string& directory, std::string (*nameOf)(int), std::string& error) {
    auto sink = std::make_unique<PngSink>(directory, nameOf);
    if (!sink->open(error)) return nullptr;
    return sink;
}
