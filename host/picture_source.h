// The interface through which a front end gives pictures to the library.
#pragma once

#include <functional>

namespace tidemark {

enum class PictureSlot { portrait = 0, landscape = 1, light = 2 };

// A set of slots, as a sum.
enum : unsigned { kPortraitPicture = 1, kLandscapePicture = 2, kBackgrounds = 3, kLightPicture = 4, kAllPictures = 7 };

// The host calls both functions during a frame, with the context current.
struct PictureSource {
    // Transfers a picture with the slot's native::transfer... method. For a background, this is the largest centred
    // part with the proportions width : height, scaled down to width x height pixels if it has more. For the light,
    // width and height are 0 and the whole picture is transferred.
    std::function<void(PictureSlot slot, int width, int height)> handOver;
    // Optional. Called with the slot's new texture bound to the active unit, so that the front end can upload pixels
    // itself.
    std::function<void(PictureSlot slot)> loaded;
};

}  // namespace tidemark
