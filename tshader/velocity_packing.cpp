#include "tshader/velocity_packing.h"

#include <bit>
#include <cstring>

#include "tshader/pairs.h"

static_assert(std::endian::native == std::endian::little, "four bytes of a texel are stored as one int");

namespace {

// Returns whole | fraction << 8; NaN packs like 127. Single precision gives the same bytes as double: c + 127 is a
// multiple of 2^-18, and no fraction of that form times 255 is close enough below an integer to round up to it.
template <class I, class F>
I packComponent(F c) {
    const F raised = c < -127.0f ? 0.0f : (c < 127.0f ? c + 127.0f : 254.0f);
    const I whole = toInt(raised);
    const I fraction = toInt((raised - toFloat(whole)) * 255.0f);
    return whole | (fraction << 8);
}

template <class I, class F>
I packTexel(Pair<F> u) {
    return packComponent<I>(u.x) | (packComponent<I>(u.y) << 16);
}

}  // namespace

void packVelocity(const vec2* velocity, std::size_t count, unsigned char* rgba) {
    std::size_t i = 0;
    for (; i + 4 <= count; i += 4) {
        const int4 texels = packTexel<int4>(loadPairs<float4>(velocity + i));
        std::memcpy(rgba + 4 * i, &texels, sizeof texels);
    }
    for (; i < count; ++i) {
        const int texel = packTexel<int>(loadPairs<float>(velocity + i));
        std::memcpy(rgba + 4 * i, &texel, sizeof texel);
    }
}
