#include "pictures/picture_file.h"

#include <stb/stb_image.h>
#include <stb/stb_image_resize.h>

#include <algorithm>
#include <cmath>
#include <memory>

#include "host/read_file.h"
#include "pictures/jpeg_file.h"

namespace {

// Four channels of two bytes, which a file holds in fewer bytes, and no more than an int counts.
constexpr std::size_t kMostBytes = 8 * std::size_t{kMostPixels};

std::size_t byteCount(int width, int height) {
    return 4 * static_cast<std::size_t>(width) * static_cast<std::size_t>(height);
}

// The reader's reason quotes bytes of the file, which may be anything.
std::string failureReason() {
    std::string reason = stbi_failure_reason();
    std::replace_if(
        reason.begin(), reason.end(), [](char c) { return c < ' ' || c > '~'; }, '?');
    return reason;
}

}  // namespace

std::optional<Picture> loadPicture(const std::string& path, std::string& error, int mostPixels) {
    const std::optional<std::string> content = readFile(path, "the picture", kMostBytes, error);
    if (!content) return std::nullopt;
    const auto* const bytes = reinterpret_cast<const stbi_uc*>(content->data());
    const int size = static_cast<int>(content->size());

    if (const char* const harm = harmIn({bytes, content->size()})) {
        error = path + " is not a JPEG picture that can be read: " + harm;
        return std::nullopt;
    }
    Picture picture;
    // Before anything is decoded: a few bytes can claim a picture that no memory holds.
    if (stbi_info_from_memory(bytes, size, &picture.width, &picture.height, nullptr) &&
        picture.height > mostPixels / std::max(picture.width, 1)) {
        error = path + " has " + std::to_string(picture.width) + "x" + std::to_string(picture.height) +
                " pixels, more than the " + std::to_string(mostPixels) + " that can be read";
        return std::nullopt;
    }
    const std::unique_ptr<stbi_uc, void (*)(void*)> pixels(
        stbi_load_from_memory(bytes, size, &picture.width, &picture.height, nullptr, STBI_rgb_alpha), stbi_image_free);
    if (!pixels) {
        error = path + " is not a PNG or JPEG picture that can be read: " + failureReason();
        return std::nullopt;
    }
    picture.rgba.assign(pixels.get(), pixels.get() + byteCount(picture.width, picture.height));
    return picture;
}

Picture fitPicture(Picture picture, int longestSide) {
    const int longer = std::max(picture.width, picture.height);
    if (longer <= longestSide) return picture;
    const auto shrink = [&](int side) {
        return std::max(1, static_cast<int>(std::lround(static_cast<double>(side) * longestSide / longer)));
    };
    Picture fitted{shrink(picture.width), shrink(picture.height), {}};
    fitted.rgba.resize(byteCount(fitted.width, fitted.height));
    stbir_resize_uint8(
        picture.rgba.data(), picture.width, picture.height, 0, fitted.rgba.data(), fitted.width, fitted.height, 0, 4);
    return fitted;
}
