#include "preview/preview.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <vector>

#include "desktop/headless_context.h"
#include "host/picture.h"
#include "host/water_host.h"
#include "preview/frame_sink.h"
#include "preview/inside.h"
#include "preview/progress.h"
#include "preview/scene.h"
#include "preview/touch_script.h"

namespace {

std::string frameName(int frame) {
    char name[32];
    std::snprintf(name, sizeof name, "frame-%04d.png", frame);
    return name;
}

// In the order of opening: what comes later may lie in a directory that was made for one before, and goes first.
struct Outputs {
    std::unique_ptr<FrameSink> pictures, inside, video;

    bool open(const PreviewOptions& options, std::string& error) {
        const auto [width, height] = options.size;
        if (!options.out.empty() && !(pictures = openPngSink(options.out, frameName, error))) return false;
        if (!options.inside.empty() && !(inside = openPngSink(options.inside, insideName, error))) return false;
        if (options.video.empty()) return true;
        video = openVideoSink(options.video, width, height, options.framesPerSecond, error);
        return video != nullptr;
    }
    bool write(const Picture& frame, bool asPicture, std::string& error) {
        return (!pictures || !asPicture || pictures->write(frame, error)) && (!video || video->write(frame, error));
    }
    bool finish(std::string& error) {
        return (!video || video->finish(error)) && (!inside || inside->finish(error)) &&
               (!pictures || pictures->finish(error));
    }
};

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
    const PreviewOptions& options, const Look& look, int frames, WaterHost& host, TouchPlayer& touches,
    Outputs& outputs, std::string& error) {
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
    if (outputs.inside) {
        for (const Picture& picture : drawInside(host, look, frame)) {
            if (!outputs.inside->write(picture, error)) return false;
        }
    }
    return outputs.finish(error);
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
    const std::optional<Look> look = chooseLook(options, error);
    if (!look) return false;
    std::optional<Pictures> pictures = choosePictures(options, error);
    if (!pictures) return false;
    const std::unique_ptr<HeadlessContext> context = HeadlessContext::create(width, height, error);
    if (!context) return false;
    fitToDriver(options, *pictures);
    Outputs outputs;
    if (!outputs.open(options, error)) return false;

    // The ink draws from this generator as well.
    srand48(static_cast<long>(options.seed));
    WaterHost host(*look, width, height, options.seed);
    host.setUp(options.withInk);
    host.loadPictures(sourceOf(*pictures, *look));
    host.rain(options.rain);
    const int frames = countFrames(options, events);
    TouchPlayer touches(std::move(events), width, height);
    return drawFrames(options, *look, frames, host, touches, outputs, error);
}
