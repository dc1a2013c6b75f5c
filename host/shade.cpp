#include "host/shade.h"

#include <algorithm>

namespace tidemark {

namespace {

// Backgrounds up to this mean brightness keep their colours. From here to white, `wet` increases linearly to its full
// effect.
constexpr float kDark = 0.35f;
constexpr float kBright = 0.85f;

// Water absorbs red first.
constexpr Shade kMostTaken = {0.62f, 0.54f, 0.46f};

}  // namespace

Shade shadeOf(const Look& look, PictureSlot slot, float brightness) {
    if (slot == PictureSlot::light) return {look.lightRed, look.lightGreen, look.lightBlue};
    const float share = look.wet * std::clamp((brightness - kDark) / (kBright - kDark), 0.0f, 1.0f);
    return {
        look.groundRed * (1.0f - share * kMostTaken.red), look.groundGreen * (1.0f - share * kMostTaken.green),
        look.groundBlue * (1.0f - share * kMostTaken.blue)};
}

}  // namespace tidemark
