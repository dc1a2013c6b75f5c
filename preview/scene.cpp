#include "preview/scene.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <utility>

#include "host/look_file.h"
#include "pictures/procedural_pictures.h"
#include "preview/picture_file.h"

namespace tidemark {

namespace {

Picture paintGround(Ground ground, int width, int height) {
    switch (ground) {
        case Ground::pool:
            return tiledPool(width, height);
        case Ground::river:
            return riverBed(width, height);
        case Ground::shore:
            break;
    }
    return sandyShore(width, height);
}

// Ink of this brightness does not change a channel; brighter ink would brighten the picture.
constexpr std::uint32_t kBrightestChannel = 0xbf;

}  // namespace

std::optional<Pictures> choosePictures(const PreviewOptions& options, std::string& error) {
    // Painted pictures have the view's resolution up to a size that still paints quickly.
    const auto [width, height] = options.size;
    const double shrink = std::min(1.0, 2048.0 / std::max(width, height));
    const int shorter = std::max(1, static_cast<int>(std::min(width, height) * shrink));
    const int longer = std::max(1, static_cast<int>(std::max(width, height) * shrink));
    const auto background = [&](const std::string& own, bool isWide) -> std::optional<Picture> {
        // Without a window the size is fixed, so only one orientation is needed.
        if (!options.inWindow && isWide != (options.size.width > options.size.height)) {
            return Picture{1, 1, {0, 0, 0, 255}};
        }
        const std::string& file = own.empty() ? options.picture : own;
        if (!file.empty()) return loadPicture(file, error);
        return paintGround(options.ground, isWide ? longer : shorter, isWide ? shorter : longer);
    };
    std::optional<Picture> portrait = background(options.portrait, false);
    if (!portrait) return std::nullopt;
    std::optional<Picture> landscape = background(options.landscape, true);
    if (!landscape) return std::nullopt;
    std::optional<Picture> light = options.light.empty() ? waterLight(512) : loadPicture(options.light, error);
    if (!light) return std::nullopt;
    return Pictures{std::move(*portrait), std::move(*landscape), std::move(*light)};
}

void fitToDriver(const std::string& file, Picture& picture) {
    GLint limit = 0;
    glGetIntegerv(GL_MAX_TEXTURE_SIZE, &limit);
    const int width = picture.width;
    const int height = picture.height;
    if (std::max(width, height) <= limit) return;
    const double scale = static_cast<double>(limit) / std::max(width, height);
    const auto shrunk = [=](int side) { return std::max(1, static_cast<int>(std::lround(side * scale))); };
    picture = fitted(picture, shrunk(width), shrunk(height));
    std::fprintf(
        stderr, "tidemark-preview: %s: scaled from %dx%d to %dx%d pixels, the most that the driver takes\n",
        file.c_str(), width, height, picture.width, picture.height);
}

std::optional<Look> chooseLook(const PreviewOptions& options, std::string& error) {
    std::optional<Look> look = options.look.empty() ? options.base : loadLook(options.look, error, options.base);
    if (!look || !options.inkColor) return look;
    std::uint32_t shown = 0;
    for (const auto& [channel, shift] : {std::pair{&look->inkRed, 16}, {&look->inkGreen, 8}, {&look->inkBlue, 0}}) {
        const std::uint32_t value = std::min(*options.inkColor >> shift & 0xff, kBrightestChannel);
        *channel = static_cast<float>(value) / 255.0f;
        shown |= value << shift;
    }
    if (shown != *options.inkColor) {
        std::fprintf(
            stderr, "tidemark-preview: the ink #%06x is too bright to darken the picture; #%06x is drawn\n",
            *options.inkColor, shown);
    }
    return look;
}

}  // namespace tidemark
