#include <filesystem>
#include <fstream>
#include <vector>

#include "preview/encoder_process.h"
#include "preview/frame_sink.h"
#include "preview/new_directories.h"

namespace fs = std::filesystem;

namespace {

struct VideoFormat {
    const char* ending;
    std::vector<std::string> encoder;  // ffmpeg's arguments
};

const VideoFormat* findFormat(const fs::path& file) {
    // H.264 halves the resolution of the colours, so it wants even sides.
    static const VideoFormat kFormats[] = {
        {".mp4",
         {"-vf", "pad=ceil(iw/2)*2:ceil(ih/2)*2,scale=out_color_matrix=bt709:out_range=tv", "-c:v", "libx264", "-crf",
          "18", "-pix_fmt", "yuv420p", "-colorspace", "bt709", "-color_primaries", "bt709", "-color_trc", "bt709",
          "-movflags", "+faststart", "-f", "mp4"}},
        {".webp", {"-c:v", "libwebp_anim", "-quality", "80", "-loop", "0", "-f", "webp"}},
        {".gif",
         {"-filter_complex", "split[seen][kept];[seen]palettegen[palette];[kept][palette]paletteuse", "-loop", "0",
          "-f", "gif"}},
    };
    for (const VideoFormat& format : kFormats) {
        if (file.extension() == format.ending) return &format;
    }
    return nullptr;
}

class VideoSink : public FrameSink {
public:
    explicit VideoSink(fs::path file) : file_(std::move(file)), part_(file_.string() + ".part") {}

    ~VideoSink() override {
        encoder_.kill();
        std::error_code ignored;
        if (partMade_) fs::remove(part_, ignored);
    }

    bool open(int width, int height, int framesPerSecond, std::string& error) {
        const VideoFormat* format = findFormat(file_);
        if (!format) {
            error = "the video " + file_.string() + " does not end in .mp4, .webp or .gif";
            return false;
        }
        if (!newDirectories_.make(file_.parent_path(), error)) return false;
        std::error_code problem;
        partMade_ = !fs::is_directory(file_, problem) && std::ofstream(part_).is_open();
        if (!partMade_) {
            error = "cannot write the video " + file_.string();
            return false;
        }

        std::vector<std::string> command = {
            "ffmpeg",
            "-hide_banner",
            "-loglevel",
            "error",
            "-y",
            "-f",
            "rawvideo",
            "-pix_fmt",
            "rgba",
            "-video_size",
            std::to_string(width) + "x" + std::to_string(height),
            "-framerate",
            std::to_string(framesPerSecond),
            "-i",
            "pipe:0"};
        command.insert(command.end(), format->encoder.begin(), format->encoder.end());
        // The time of day and the encoder's version stay out of the file.
        command.insert(command.end(), {"-fflags", "+bitexact", "-flags:v", "+bitexact", "file:" + part_.string()});
        return encoder_.start(command, error);
    }

    bool write(const Picture& frame, std::string& error) override {
        return encoder_.write(frame.rgba.data(), frame.rgba.size(), error);
    }

    bool finish(std::string& error) override {
        if (!encoder_.finish(error)) return false;
        std::error_code problem;
        fs::rename(part_, file_, problem);
        if (problem) {
            error = "cannot write the video " + file_.string() + ": " + problem.message();
            return false;
        }
        partMade_ = false;
        newDirectories_.keep();
        return true;
    }

private:
    NewDirectories newDirectories_;
    EncoderProcess encoder_;
    fs::path file_, part_;
    bool partMade_ = false;
};

}  // namespace

std::unique_ptr<FrameSink> openVideoSink(
    const std::string& file, int width, int height, int framesPerSecond, std::string& error) {
    auto sink = std::make_unique<VideoSink>(file);
    if (!sink->open(width, height, framesPerSecond, error)) return nullptr;
    return sink;
}
