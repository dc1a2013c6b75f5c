#include "preview/scene.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cstdio>
#include <functional>

#include "host/look_file.h"
#include "pictures/picture_file.h"
#include "pictures/procedural_pictures.h"

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

// The picture of `file`, or the built-in one where there is no file.
std::optional<Picture> choosePicture(
    const std::string& file, const std::function<Picture()>& builtIn, std::string& error) {
    return file.empty() ? builtIn() : loadPicture(file, error);
}

}  // namespace

std::optional<Pictures> choosePictures(const PreviewOptions& options, std::string& error) {
    // The built-in pictures stay as sharp as the view up to a size where they take too long to make.
    const auto [width, height] = options.size;
    const double shrink = std::min(1.0, 2048.0 / std::max(width, height));
    const int shorter = std::max(1, static_cast<int>(std::min(width, height) * shrink));
    const int longer = std::max(1, static_cast<int>(std::max(width, height) * shrink));
    std::optional<Picture> portrait = choosePicture(
        options.portrait, [&] { return paintGround(options.ground, shorter, longer); }, error);
    if (!portrait) return std::nullopt;
    std::optional<Picture> landscape = choosePicture(
        options.landscape, [&] { return paintGround(options.ground, longer, shorter); }, error);
    if (!landscape) return std::nullopt;
    std::optional<Picture> water = choosePicture(
        options.light, [] { return waterLight(512); }, error);
    if (!water) return std::nullopt;
    return Pictures{std::move(*portrait), std::move(*landscape), std::move(*water)};
}

namespace {

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

}  // namespace

void fitToDriver(const PreviewOptions& options, Pictures& pictures) {
    fitToDriver(options.portrait, pictures.portrait);
    fitToDriver(options.landscape, pictures.landscape);
    fitToDriver(options.light, pictures.light);
}

std::optional<Look> chooseLook(const PreviewOptions& options, std::string& error) {
    std::optional<Look> look = options.look.empty() ? options.base : loadLook(options.look, error, options.base);
    if (look && options.inkColor) {
        look->inkRed = options.inkColor->red;
        look->inkGreen = options.inkColor->green;
        look->inkBlue = options.inkColor->blue;
    }
    return look;
}
