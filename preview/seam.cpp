#include "preview/seam.h"

#include <cstddef>

namespace tidemark {

const Picture* Seam::shown(int number, const Picture& frame) {
    if (number < fade_) {
        beginning_.push_back(frame);
        return nullptr;
    }
    if (number < round_) return &frame;
    Picture& mixed = beginning_[static_cast<std::size_t>(number - round_)];
    const int share = 256 * (number - round_ + 1) / (fade_ + 1);
    for (std::size_t i = 0; i < mixed.rgba.size(); ++i) {
        mixed.rgba[i] = static_cast<std::uint8_t>((mixed.rgba[i] * share + frame.rgba[i] * (256 - share) + 128) >> 8);
    }
    return &mixed;
}

}  // namespace tidemark
