#include "preview/preview.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <memory>
#include <vector>

#include "desktop/headless_context.h"
#include "host/picture.h"
#include "host/water_host.h"
#include "preview/fields.h"
#include "preview/interrupt.h"
#include "preview/output.h"
#include "preview/progress.h"
#include "preview/scene.h"
#include "preview/seam.h"
#include "preview/touch_script.h"

namespace tidemark {

namespace {

// Reads framebuffer 0. GL's rows start at the bottom.
void readFrame(Picture& frame) {
    glReadPixels(0, 0, frame.width, frame.height, GL_RGBA, GL_UNSIGNED_BYTE, frame.rgba.data());
    const auto rowBytes = static_cast<std::ptrdiff_t>(frame.width) * 4;
    for (std::ptrdiff_t low = 0, high = frame.height - 1; low < high; ++low, --high) {
        const auto row = frame.rgba.begin() + low * rowBytes;
        std::swap_ranges(row, row + rowBytes, frame.rgba.begin() + high * rowBytes);
    }
}

// The lengths of a run's parts, in frames.
struct Plan {
    int warmUp = 0;  // rounds before the clip, so that a looping clip begins in the state in which it ends
    int round;
    int fade = 0;  // at the end of the clip, into its first frames

    int total() const { return warmUp + round + fade; }
};

Plan makePlan(const PreviewOptions& options, const Look& look, const std::vector<TouchEvent>& events) {
    double seconds = events.empty() ? 4.0 : static_cast<double>(events.back().timeMs) / 1000.0 + 1.5;
    // A single picture needs only the frames up to it.
    if (options.at)
        seconds = options.out.empty() && options.video.empty() ? *options.at : std::max(seconds, *options.at);
    const auto frames = [&](double time) { return static_cast<int>(std::lround(time * options.framesPerSecond)); };
    Plan plan = {.round = std::max(1, frames(options.seconds.value_or(seconds)))};
    if (!options.loop) return plan;
    const int calming = frames(std::min(double{look.calmingTime}, 30.0));
    plan.warmUp = (calming + plan.round - 1) / plan.round * plan.round;
    // The faded frames are kept in memory, at most 1 GiB.
    const auto affordable = (std::int64_t{1} << 28) / (std::int64_t{options.size.width} * options.size.height);
    plan.fade = static_cast<int>(std::min({std::int64_t{frames(0.5)}, std::int64_t{plan.round / 2}, affordable}));
    return plan;
}

// Repeats the script for each round.
std::vector<TouchEvent> repeated(const std::vector<TouchEvent>& events, const Plan& plan, int framesPerSecond) {
    std::vector<TouchEvent> all;
    for (int start = 0; start < plan.total(); start += plan.round) {
        for (TouchEvent event : events) {
            event.timeMs += std::int64_t{1000} * start / framesPerSecond;
            all.push_back(event);
        }
    }
    return all;
}

bool drawFrames(
    const PreviewOptions& options, const Look& look, const Plan& plan, WaterHost& host, TouchPlayer& touches,
    Output& output, Progress& progress, std::string& error) {
    const auto [width, height] = options.size;
    Picture frame{width, height, std::vector<std::uint8_t>(4 * static_cast<std::size_t>(width * height))};
    const double length = static_cast<double>(plan.round) / options.framesPerSecond;
    const auto still = std::lround(options.at.value_or(length) * options.framesPerSecond) - 1;
    Seam seam(plan.round, plan.fade);
    for (int i = 0; i < plan.total() && !interrupted(); ++i) {
        touches.deliverBefore((i + 1) * 1000.0 / options.framesPerSecond, host);
        host.rain(options.rainFrom && i % plan.round >= *options.rainFrom * options.framesPerSecond);
        if (host.advance(1.0 / options.framesPerSecond)) {
            host.draw();
            readFrame(frame);
        }
        progress.show(i + 1, plan.total());
        const int number = i - plan.warmUp;
        if (number < 0) continue;
        if (!options.still.empty() && number == std::max(still, 0L) &&
            !output.writePicture(options.still, frame, error)) {
            return false;
        }
        const Picture* const shown = seam.shown(number, frame);
        if (shown && !output.write(*shown, error)) return false;
    }
    if (output.frames() == 0) {
        error = "interrupted before the first frame";
        return false;
    }
    if (!options.fields.empty()) {
        int i = 0;
        for (const Picture& picture : drawFields(host, look, frame)) {
            const std::filesystem::path path = std::filesystem::path(options.fields) / fieldName(i++);
            if (!output.writePicture(path, picture, error)) return false;
        }
    }
    return output.finish(error);
}

std::string describe(const PreviewOptions& options, int frames, int planned, const std::string& files) {
    const std::string size = std::to_string(options.size.width) + "x" + std::to_string(options.size.height);
    char seconds[32];
    std::snprintf(seconds, sizeof seconds, "%.2f", static_cast<double>(frames) / options.framesPerSecond);
    return (frames < planned ? "Interrupted: drew " + std::to_string(frames) + " of " + std::to_string(planned)
                             : "Drew " + std::to_string(frames)) +
           (planned == 1 ? " frame, " : " frames, ") + seconds + " s of " + size + " pixels" +
           (files.empty() ? "" : ": ") + files;
}

}  // namespace

bool runPreview(const PreviewOptions& options, std::string& summary, std::string& error) {
    const auto [width, height] = options.size;
    Output output(options);
    if (!output.check(error)) return false;
    std::vector<TouchEvent> events;
    if (!options.script.empty()) {
        std::optional<std::vector<TouchEvent>> loaded = loadTouchScript(options.script, error);
        if (!loaded) return false;
        events = std::move(*loaded);
    }
    const std::optional<Look> look = chooseLook(options, error);
    if (!look) return false;
    const Plan plan = makePlan(options, *look, events);
    if (options.loop && !events.empty() && events.back().timeMs * options.framesPerSecond > plan.round * 1000LL) {
        error = "--loop: the script is longer than --seconds";
        return false;
    }
    Progress progress(
        "Getting the pictures ready, and " + std::to_string(width) + "x" + std::to_string(height) + " pixels of water");
    std::optional<Pictures> pictures = choosePictures(options, error);
    if (!pictures) return false;
    const std::unique_ptr<HeadlessContext> context = HeadlessContext::create(width, height, error);
    if (!context) return false;
    fitToDriver(options.light, pictures->light);

    // The ink draws from this generator as well.
    srand48(static_cast<long>(options.seed));
    WaterHost host(*look, width, height, options.seed);
    host.setUp(options.withInk);
    host.loadPictures(sourceOf(*pictures, *look));
    TouchPlayer touches(repeated(events, plan, options.framesPerSecond), width, height);
    recordInterrupts();
    if (!output.open(error) || !drawFrames(options, *look, plan, host, touches, output, progress, error)) return false;
    summary = describe(options, output.frames(), plan.round, output.summary());
    return true;
}

}  // namespace tidemark
