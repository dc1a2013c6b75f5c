// The files that a run writes.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "preview/ffmpeg.h"
#include "preview/new_file.h"
#include "preview/preview.h"

namespace tidemark {

// The frames of a run as pictures and as a video, and single pictures. What was there before stays unless the options
// say otherwise. What is destroyed before it has finished leaves no frames and no video.
class Output {
public:
    explicit Output(const PreviewOptions& options) : options_(options) {}
    ~Output();
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    // All of these say why in `error` on failure.

    // Whether all that the options name may be written.
    bool check(std::string& error) const;
    bool open(std::string& error);
    bool write(const Picture& frame, std::string& error);
    bool writePicture(const std::filesystem::path& path, const Picture& picture, std::string& error);
    bool finish(std::string& error);

    int frames() const { return frames_; }

    // The files and their sizes, in a part of a line.
    std::string summary() const { return summary_; }

private:
    bool openFrames(std::string& error);
    bool openVideo(std::string& error);
    bool keepFrames(std::string& error);
    void tell(const std::string& what, std::uintmax_t bytes);

    const PreviewOptions& options_;
    Ffmpeg pictures_, video_;
    std::filesystem::path part_;  // where the frames are before they are kept
    NewFile videoFile_;
    int frames_ = 0;
    std::string summary_;
};

// "1.2 MB"
std::string sizeInWords(std::uintmax_t bytes);

}  // namespace tidemark
