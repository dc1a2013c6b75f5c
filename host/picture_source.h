// How a face gives the library its pictures.
#pragma once

#include <functional>

namespace tidemark {

enum class PictureSlot { portrait = 0, landscape = 1, light = 2 };

// Some of the three slots, as a sum.
enum : unsigned { kPortraitPicture = 1, kLandscapePicture = 2, kBackgrounds = 3, kLightPicture = 4, kAllPictures = 7 };

// The host calls both functions in the middle of a frame, with the context current.
struct PictureSource {
    // Hands a picture over, by the slot's native::transfer... method. Of a background, the largest middle part in the
    // proportions width : height; where that part has more than width x height pixels, it is scaled down to as many.
    // The light is handed over whole, and its width and height are 0.
    std::function<void(PictureSlot slot, int width, int height)> handOver;
    // Called with the slot's new texture bound to the active unit, which the face may fill instead. May be empty.
    std::function<void(PictureSlot slot)> loaded;
};

}  // namespace tidemark
