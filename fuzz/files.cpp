// The files that the preview reads: a picture after a 'p', a look after an 'l', after any other first byte a touch
// script.
#include <sys/mman.h>
#include <unistd.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <sstream>
#include <string>
#include <string_view>
#include <vector>

#include "fuzz/library_state.h"
#include "fuzz/require.h"
#include "host/look_file.h"
#include "pictures/picture_file.h"
#include "preview/touch_script.h"

namespace {

constexpr int kViewWidth = 96;
constexpr int kViewHeight = 144;
constexpr int kMostPixels = 1 << 16;
constexpr std::size_t kMostEvents = 32;

void requireReason(const std::string& error, const std::string& name) {
    require(error.starts_with(name), "an error does not name its file");
    require(error.find('\n') == error.npos, "an error takes several lines");
}

void requireSoundEvents(const std::vector<TouchEvent>& events) {
    std::int64_t earliest = 0;
    for (const TouchEvent& event : events) {
        require(event.timeMs >= earliest, "the time goes back");
        require(event.pressure >= 0.0f && event.pressure <= 10.0f, "the pressure is out of its range");
        earliest = event.timeMs;
    }
}

// Through the host into the library, which must stay sound whatever the finger does.
void play(const std::vector<TouchEvent>& events, const Look& look) {
    resetLibrary();
    WaterHost host(look, kViewWidth, kViewHeight, 1);
    host.setUp(true);
    TouchPlayer player(events, kViewWidth, kViewHeight);
    for (std::size_t i = 0; i < std::min(events.size(), kMostEvents); ++i) {
        player.deliverBefore(static_cast<double>(events[i].timeMs) + 0.5, host);
        if (host.advance(1.0 / 60)) host.draw();
        requireSoundLibrary();
    }
    for (const float height : host.heights()) require(std::isfinite(height), "a height is not a number");
}

void readLook(std::string_view text) {
    std::istringstream stream{std::string(text)};
    std::string error;
    const std::optional<Look> look = parseLook(stream, "a.look", error);
    if (!look) return requireReason(error, "a.look:");
    const TouchCoordinate start = {20, true}, end = {80, true};
    play({{0, TouchAction::down, start, start, 1.0f}, {16, TouchAction::move, end, end, 1.0f}}, *look);
}

void readScript(std::string_view text) {
    std::istringstream stream{std::string(text)};
    std::string error;
    const auto events = parseTouchScript(stream, "a.touch", error);
    if (!events) return requireReason(error, "a.touch:");
    requireSoundEvents(*events);
    Look look;
    look.meshVertices = 16;
    play(*events, look);
}

// A file without a directory entry.
class MemoryFile {
public:
    explicit MemoryFile(std::string_view content) : descriptor_(memfd_create("picture", 0)) {
        require(
            write(descriptor_, content.data(), content.size()) == static_cast<ssize_t>(content.size()),
            "no memory for a file");
    }
    ~MemoryFile() { close(descriptor_); }
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;

    std::string path() const { return "/proc/self/fd/" + std::to_string(descriptor_); }

private:
    int descriptor_;
};

void requireSoundPicture(const Picture& picture) {
    require(picture.width > 0 && picture.height > 0, "a picture without pixels");
    const auto pixels = static_cast<std::size_t>(picture.width) * static_cast<std::size_t>(picture.height);
    require(picture.rgba.size() == 4 * pixels, "a picture's size is not that of its pixels");
}

void readPicture(std::string_view content) {
    const MemoryFile file(content);
    std::string error;
    const std::optional<Picture> picture = loadPicture(file.path(), error, kMostPixels);
    if (!picture) return requireReason(error, file.path());
    requireSoundPicture(*picture);
    require(picture->width <= kMostPixels / picture->height, "a picture has too many pixels");
    requireSoundPicture(cropToAspect(*picture, 9, 16));
    const Picture fitted = fitPicture(*picture, 16);
    requireSoundPicture(fitted);
    require(std::max(fitted.width, fitted.height) <= 16, "a picture does not fit");
}

}  // namespace

// Memory that nobody has written holds the same in every run.
extern "C" const char* __asan_default_options() {
    return "allocator_may_return_null=1:max_allocation_size_mb=256:quarantine_size_mb=16"
           ":max_malloc_fill_size=1048576:malloc_fill_byte=255";
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    if (bytes.empty()) return 0;
    if (bytes.front() == 'p') {
        readPicture(bytes.substr(1));
    } else if (bytes.front() == 'l') {
        readLook(bytes.substr(1));
    } else {
        readScript(bytes.substr(1));
    }
    return 0;
}
