#include "fuzz/library_state.h"

#include <android/log.h>
#include <sanitizer/allocator_interface.h>
#include <xmmintrin.h>

#include <cstdint>
#include <cstdlib>
#include <utility>

#include "fuzz/require.h"
#include "jni/bitmaps.h"
#include "probes/gesture_state.h"

namespace {

constexpr unsigned kModes = ~0x3fU;  // MXCSR without its exception flags

unsigned hostModes = 0;

BitmapSlot* const slots[] = {&portraitSlot, &landscapeSlot, &waterSlot};

// Divides the block's size, because width * height * bytesOfOne may exceed 64 bits.
void requireRoom(const void* block, std::uint64_t bytesOfOne, std::uint64_t width, std::uint64_t height) {
    require(
        __sanitizer_get_ownership(block) && __sanitizer_get_allocated_size(block) / bytesOfOne >= width * height,
        "a block is smaller than its size says");
}

template <class T>
void requireSoundGrid(const Texture<T>& grid) {
    const Texture<vec2>& velocity = fluid.VelocityTex;
    require(!grid.data == !velocity.data, "some of the ink's grids are missing");
    if (!grid.data) return;
    require(grid.width == velocity.width && grid.height == velocity.height, "the ink's grids differ in size");
    requireRoom(grid.data, sizeof(T), static_cast<std::uint64_t>(grid.width), static_cast<std::uint64_t>(grid.height));
}

}  // namespace

void resetLibrary() {
    __android_log_set_logger([](const __android_log_message*) {});
    resetGestures();
    for (BitmapSlot* const slot : slots) {
        std::free(std::exchange(slot->pixels, nullptr));
        slot->bytes = 0;
        slot->info = {};
    }
    srand48(1);
    hostModes = _mm_getcsr() & kModes;
}

void requireValidState() {
    for (const BitmapSlot* const slot : slots) {
        if (slot->pixels) requireRoom(slot->pixels, 4, slot->info.width, slot->info.height);
    }
    requireSoundGrid(fluid.VelocityTex);
    requireSoundGrid(fluid.VelocityTexTemp);
    requireSoundGrid(fluid.PressureTex);
    requireSoundGrid(fluid.PressureTexTemp);
    requireSoundGrid(fluid.DivergenceTex);
    require((_mm_getcsr() & kModes) == hostModes, "the processor's floating-point modes have changed");

    const Texture<vec2>& flow = fluid.VelocityTex;
    if (flow.empty()) return;
    // 0 * x is 0 if x is finite, else NaN. One test of the sum is fast, and this runs after every call.
    float zero = 0.0f;
    for (const vec2* v = flow.row(0); v != flow.row(flow.height); ++v) zero += 0.0f * v->x + 0.0f * v->y;
    require(zero == 0.0f, "the flow of the ink is not finite");
}
