#include "preview/output.h"

#include <algorithm>
#include <cstdio>

#include "preview/fields.h"
#include "preview/picture_file.h"

namespace tidemark {

namespace fs = std::filesystem;

namespace {

std::string frameName(int picture) {
    char name[32];
    std::snprintf(name, sizeof name, "frame-%04d.png", picture);
    return name;
}

// Counts the consecutive frames in a folder.
int countFrames(const fs::path& folder) {
    int count = 0;
    while (fs::exists(folder / frameName(count))) ++count;
    return count;
}

std::string videoFormat(const std::string& ending, int crf) {
    if (ending == ".gif") {
        return "-filter_complex split[seen][kept];[seen]palettegen[palette];[kept][palette]paletteuse -loop 0 -f gif";
    }
    if (ending == ".webp") return "-c:v libwebp_anim -quality 80 -loop 0 -f webp";
    // H.264 stores colours at half the resolution and therefore needs even sides.
    return "-vf pad=ceil(iw/2)*2:ceil(ih/2)*2,scale=out_color_matrix=bt709:out_range=tv -c:v libx264 -pix_fmt yuv420p"
           " -colorspace bt709 -color_primaries bt709 -color_trc bt709 -movflags +faststart -f mp4 -crf " +
           std::to_string(crf);
}

bool cannotWrite(const std::string& what, std::string& error) {
    error = "cannot write " + what + ": " + error;
    return false;
}

}  // namespace

std::string sizeInWords(std::uintmax_t bytes) {
    const double kilobytes = static_cast<double>(bytes) / 1000.0;
    char text[32];
    std::snprintf(
        text, sizeof text, kilobytes < 1000.0 ? "%.1f kB" : "%.1f MB",
        kilobytes < 1000.0 ? kilobytes : kilobytes / 1000);
    return text;
}

Output::~Output() {
    std::error_code ignored;
    if (!part_.empty()) fs::remove_all(part_, ignored);
}

bool Output::check(std::string& error) const {
    std::vector<fs::path> paths;
    if (!options_.out.empty()) paths.push_back(fs::path(options_.out) / frameName(0));
    if (!options_.video.empty()) paths.emplace_back(options_.video);
    if (!options_.still.empty()) paths.emplace_back(options_.still);
    for (int i = 0; i < 4 && !options_.fields.empty(); ++i) paths.push_back(fs::path(options_.fields) / fieldName(i));
    return std::all_of(
        paths.begin(), paths.end(), [&](const fs::path& path) { return mayWrite(path, options_.force, error); });
}

bool Output::open(std::string& error) {
    return (options_.out.empty() || openFrames(error)) && (options_.video.empty() || openVideo(error));
}

bool Output::openFrames(std::string& error) {
    const fs::path part = partOf(fs::path(options_.out) / "frames");
    if (!makeFolder(part, error)) return false;
    part_ = part;
    // ffmpeg interprets % in a file name as the start of a frame number.
    std::string folder;
    for (const char c : part.string()) folder += c == '%' ? "%%" : std::string(1, c);
    return pictures_.startWriting(
        options_.size.width, options_.size.height, options_.framesPerSecond,
        std::string(kPng) + " -start_number 0 -f image2", folder + "/frame-%04d.png", error);
}

bool Output::openVideo(std::string& error) {
    const std::string format = videoFormat(fs::path(options_.video).extension(), options_.crf);
    return videoFile_.make(options_.video, options_.force, error) &&
           video_.startWriting(
               options_.size.width, options_.size.height, options_.framesPerSecond, format, videoFile_.part(), error);
}

bool Output::write(const Picture& frame, std::string& error) {
    const bool asPicture = !options_.out.empty() && frames_ % options_.every == 0;
    ++frames_;
    if (asPicture && !pictures_.write(frame, error)) return cannotWrite("the frames to " + options_.out, error);
    if (!options_.video.empty() && !video_.write(frame, error)) return cannotWrite(options_.video, error);
    return true;
}

bool Output::writePicture(const fs::path& path, const Picture& picture, std::string& error) {
    NewFile file;
    if (!file.make(path, options_.force, error)) return false;
    if (!savePicture(picture, file.part(), error)) return cannotWrite(path, error);
    const std::uintmax_t bytes = fs::file_size(file.part());
    if (!file.keep(error)) return false;
    addToSummary(path, bytes);
    return true;
}

bool Output::finish(std::string& error) {
    if (!options_.video.empty()) {
        if (!video_.finish(error)) return cannotWrite(options_.video, error);
        const std::uintmax_t bytes = fs::file_size(videoFile_.part());
        if (!videoFile_.keep(error)) return false;
        addToSummary(options_.video, bytes);
    }
    if (options_.out.empty()) return true;
    if (!pictures_.finish(error)) return cannotWrite("the frames to " + options_.out, error);
    return keepFrames(error);
}

bool Output::keepFrames(std::string& error) {
    const fs::path folder = options_.out;
    const int count = (frames_ + options_.every - 1) / options_.every;
    std::uintmax_t bytes = 0;
    for (int i = 0; i < count; ++i) {
        const fs::path part = part_ / frameName(i);
        bytes += fs::file_size(part);
        if (!rename(part, folder / frameName(i), options_.force, error)) return false;
    }
    // Removes the remaining frames of an earlier, longer run; otherwise the folder would mix two runs.
    for (int i = countFrames(folder) - 1; options_.force && i >= count; --i) fs::remove(folder / frameName(i));
    addToSummary((folder / frameName(0)).string() + (count > 1 ? " to " + frameName(count - 1) : ""), bytes);
    return true;
}

void Output::addToSummary(const std::string& what, std::uintmax_t bytes) {
    summary_ += (summary_.empty() ? "" : ", ") + what + " (" + sizeInWords(bytes) + ")";
}

}  // namespace tidemark
