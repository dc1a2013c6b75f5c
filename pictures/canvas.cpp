#include "pictures/canvas.h"

#include <cmath>

namespace tidemark {

namespace {

std::uint8_t toByte(float linear) {
    return static_cast<std::uint8_t>(std::sqrt(std::clamp(linear, 0.0f, 1.0f)) * 255.0f + 0.5f);
}

float toLinear(std::uint8_t byte) {
    const float root = static_cast<float>(byte) / 255.0f;
    return root * root;
}

}  // namespace

Picture toPicture(const Canvas& canvas) {
    Picture picture{canvas.width, canvas.height, {}};
    picture.rgba.reserve(4 * canvas.pixels.size());
    for (const Rgb& light : canvas.pixels) {
        for (const float channel : {light.r, light.g, light.b}) picture.rgba.push_back(toByte(channel));
        picture.rgba.push_back(255);
    }
    return picture;
}

Canvas toCanvas(const Picture& picture) {
    Canvas canvas(picture.width, picture.height);
    const std::uint8_t* bytes = picture.rgba.data();
    for (Rgb& light : canvas.pixels) {
        light = {toLinear(bytes[0]), toLinear(bytes[1]), toLinear(bytes[2])};
        bytes += 4;
    }
    return canvas;
}

}  // namespace tidemark
