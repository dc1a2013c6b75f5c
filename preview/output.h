// The files that a run writes.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "preview/ffmpeg.h"
#include "preview/new_file.h"
#include "preview/preview.h"

namespace tidemark {

// Writes the frames of a run as pictures and as a video, and single pictures. Existing files are kept unless --force is
// set. If it is destroyed before finish(), it leaves no frames and no video.
class Output {
public:
    explicit Output(const PreviewOptions& options) : options_(options) {}
    ~Output();
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;

    // On failure all functions store the reason in `error`.

    // Returns whether all outputs may be written.
    bool check(std::string& error) const;
    bool open(std::string& error);
    bool write(const Picture& frame, std::string& error);
    bool writePicture(const std::filesystem::path& path, const Picture& picture, std::string& error);
    bool finish(std::string& error);

    int frames() const { return frames_; }

    // Returns the names and sizes of the files, for the closing line.
    std::string summary() const { return summary_; }

private:
    bool openFrames(std::string& error);
    bool openVideo(std::string& error);
    bool keepFrames(std::string& error);
    void addToSummary(const std::string& what, std::uintmax_t bytes);

    const PreviewOptions& options_;
    Ffmpeg pictures_, video_;
    std::filesystem::path part_;  // temporary folder of the frames
    NewFile videoFile_;
    int frames_ = 0;
    std::string summary_;
};

// Formats a size, for example "1.2 MB".
std::string sizeInWords(std::uintmax_t bytes);

}  // namespace tidemark
