#include "preview/preview.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <functional>
#include <memory>
#include <vector>

#include "host/water_host.h"
#include "platform/headless_context.h"
#include "preview/frame_sink.h"
#include "preview/picture_file.h"
#include "preview/procedural_pictures.h"
#include "preview/progress.h"
#include "preview/touch_script.h"

namespace {

// The video is closed, or taken back, before the directory of the pictures that may hold it.
struct Outputs {
    std::unique_ptr<FrameSink> pictures, video;

    bool open(const PreviewOptions& options, std::string& error) {
        const auto [width, height] = options.size;
        if (!options.out.empty() && !(pictures = openPngSink(options.out, error))) return false;
        if (options.video.empty()) return true;
        video = openVideoSink(options.video, width, height, options.framesPerSecond, error);
        return video != nullptr;
    }
    bool write(const Picture& frame, bool asPicture, std::string& error) {
        return (!pictures || !asPicture || pictures->write(frame, error)) && (!video || video->write(frame, error));
    }
    bool finish(std::string& error) {
        return (!video || video->finish(error)) && (!pictures || pictures->finish(error));
    }
};

// The picture of `file`, or the built-in one where there is no file.
bool choosePicture(
    const std::string& file, const std::function<Picture()>& builtIn, Picture& picture, std::string& error) {
    if (file.empty()) {
        picture = builtIn();
        return true;
    }
    std::optional<Picture> loaded = loadPicture(file, error);
    if (loaded) picture = std::move(*loaded);
    return loaded.has_value();
}

bool choosePictures(const PreviewOptions& options, Pictures& pictures, std::string& error) {
    // The built-in pictures stay as sharp as the view up to a size where they take too long to make.
    const auto [width, height] = options.size;
    const double shrink = std::min(1.0, 2048.0 / std::max(width, height));
    const int shorter = std::max(1, static_cast<int>(std::min(width, height) * shrink));
    const int longer = std::max(1, static_cast<int>(std::max(width, height) * shrink));
    return choosePicture(
               options.portrait, [&] { return riverBed(shorter, longer); }, pictures.portrait, error) &&
           choosePicture(
               options.landscape, [&] { return riverBed(longer, shorter); }, pictures.landscape, error) &&
           choosePicture(
               options.water, [] { return waterLight(512); }, pictures.water, error);
}

void fitToDriver(const std::string& file, Picture& picture) {
    GLint limit = 0;
    glGetIntegerv(GL_MAX_TEXTURE_SIZE, &limit);
    const int width = picture.width;
    const int height = picture.height;
    if (std::max(width, height) <= limit) return;
    picture = fitPicture(std::move(picture), limit);
    std::fprintf(
        stderr, "tidemark-preview: %s: scaled from %dx%d to %dx%d pixels, the most that the driver takes\n",
        file.c_str(), width, height, picture.width, picture.height);
}

// GL's rows come from the bottom.
void readFrame(Picture& frame) {
    glReadPixels(0, 0, frame.width, frame.height, GL_RGBA, GL_UNSIGNED_BYTE, frame.rgba.data());
    const auto rowBytes = static_cast<std::ptrdiff_t>(frame.width) * 4;
    for (std::ptrdiff_t low = 0, high = frame.height - 1; low < high; ++low, --high) {
        const auto row = frame.rgba.begin() + low * rowBytes;
        std::swap_ranges(row, row + rowBytes, frame.rgba.begin() + high * rowBytes);
    }
}

int countFrames(const PreviewOptions& options, const std::vector<TouchEvent>& events) {
    const double ownLength = events.empty() ? 4.0 : static_cast<double>(events.back().timeMs) / 1000.0 + 1.5;
    return std::max(1, static_cast<int>(std::lround(options.seconds.value_or(ownLength) * options.framesPerSecond)));
}

bool drawFrames(
    const PreviewOptions& options, int frames, WaterHost& host, TouchPlayer& touches, Outputs& outputs,
    std::string& error) {
    const auto [width, height] = options.size;
    Picture frame{width, height, std::vector<std::uint8_t>(4 * static_cast<std::size_t>(width * height))};
    Progress progress(frames);
    for (int i = 0; i < frames; ++i) {
        touches.deliverBefore((i + 1) * 1000.0 / options.framesPerSecond, host);
        if (host.advance(1.0 / options.framesPerSecond)) {
            host.draw();
            readFrame(frame);
        }
        if (!outputs.write(frame, i % options.every == 0, error)) return false;
        progress.show(i + 1);
    }
    return outputs.finish(error);
}

Look lookFor(const PreviewOptions& options) {
    Look look;
    if (options.inkColor) {
        look.inkRed = options.inkColor->red;
        look.inkGreen = options.inkColor->green;
        look.inkBlue = options.inkColor->blue;
    }
    return look;
}

}  // namespace

bool runPreview(const PreviewOptions& options, std::string& error) {
    const auto [width, height] = options.size;
    std::vector<TouchEvent> events;
    if (!options.script.empty()) {
        std::optional<std::vector<TouchEvent>> loaded = loadTouchScript(options.script, error);
        if (!loaded) return false;
        events = std::move(*loaded);
    }
    Pictures pictures;
    if (!choosePictures(options, pictures, error)) return false;
    const std::unique_ptr<HeadlessContext> context = HeadlessContext::create(width, height, error);
    if (!context) return false;
    fitToDriver(options.portrait, pictures.portrait);
    fitToDriver(options.landscape, pictures.landscape);
    fitToDriver(options.water, pictures.water);
    Outputs outputs;
    if (!outputs.open(options, error)) return false;

    // The ink draws from this generator as well.
    srand48(static_cast<long>(options.seed));
    WaterHost host(lookFor(options), width, height, options.seed);
    host.handOver(pictures.portrait, pictures.landscape, pictures.water);
    host.setUp(options.withInk);
    host.rain(options.rain);
    const int frames = countFrames(options, events);
    TouchPlayer touches(std::move(events), width, height);
    return drawFrames(options, frames, host, touches, outputs, error);
}
