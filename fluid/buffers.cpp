#include "fluid/buffers.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>

#include "base/log.h"
#include "fluid/fluid.h"
#include "fluid/ink_tuning.h"
#include "gl/targets.h"

namespace {

template <class T>
void release(Texture<T>& texture) {
    std::free(texture.data);
    texture = {};
}

// The five buffers of a square grid of this side take 800 MB.
constexpr int kLargestGrid = kLargestSide / kCellPixels;

template <class T>
bool renew(Texture<T>& texture, int width, int height) {
    std::free(texture.data);
    // A view smaller than a cell has an empty grid. It gets a block of one byte, because null means failure.
    const std::uint64_t bytes =
        std::uint64_t{sizeof(T)} * static_cast<std::uint64_t>(width) * static_cast<std::uint64_t>(height);
    const bool fits = width <= kLargestGrid && height <= kLargestGrid && bytes <= SIZE_MAX / 2;
    texture = {
        fits ? static_cast<T*>(std::malloc(std::max<std::size_t>(static_cast<std::size_t>(bytes), 1))) : nullptr, width,
        height};
    return texture.data;
}

void clear(const Texture<vec2>& texture) {
    std::memset(
        static_cast<void*>(texture.data), 0,
        sizeof(vec2) * static_cast<std::size_t>(texture.width) * static_cast<std::size_t>(texture.height));
}

}  // namespace

void allocateBuffers(Fluid& engine) {
    const int width = std::max(engine.GridWidth, 0);
    const int height = std::max(engine.GridHeight, 0);
    if (!renew(engine.VelocityTex, width, height) || !renew(engine.VelocityTexTemp, width, height) ||
        !renew(engine.PressureTex, width, height) || !renew(engine.PressureTexTemp, width, height) ||
        !renew(engine.DivergenceTex, width, height)) {
        LOG_ERROR("no memory for an ink grid of %d x %d", width, height);
        freeBuffers(engine);
        return;
    }
    clear(engine.VelocityTex);
    clear(engine.VelocityTexTemp);
}

void freeBuffers(Fluid& engine) {
    release(engine.VelocityTex);
    release(engine.VelocityTexTemp);
    release(engine.PressureTex);
    release(engine.PressureTexTemp);
    release(engine.DivergenceTex);
}
