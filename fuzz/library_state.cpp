#include "fuzz/library_state.h"

#include <android/log.h>
#include <sanitizer/allocator_interface.h>
#include <xmmintrin.h>

#include <cstdint>
#include <cstdlib>
#include <initializer_list>
#include <utility>

#include "fuzz/require.h"
#include "jni/bitmaps.h"
#include "tests/support/gesture_state.h"

namespace {

constexpr unsigned kModes = ~0x3fU;  // all but the flags of past operations

unsigned hostModes = 0;

bool owns(const void* block, std::uint64_t bytes) {
    return __sanitizer_get_ownership(block) && __sanitizer_get_allocated_size(block) >= bytes;
}

void dropPicture(AndroidBitmapInfo& info, std::uint8_t*& pixels) {
    std::free(std::exchange(pixels, nullptr));
    info = {};
}

void requireSoundPicture(const AndroidBitmapInfo& info, const std::uint8_t* pixels) {
    if (!pixels) return;
    // Divided instead of multiplied: the product of two sides may be beyond 64 bits once it is counted in bytes.
    const std::uint64_t texels = std::uint64_t{info.width} * info.height;
    require(texels <= SIZE_MAX / 4 && owns(pixels, 4 * texels), "a picture is smaller than its size says");
}

template <class T>
void requireSoundGrid(const Texture<T>& grid) {
    const Texture<vec2>& velocity = fluid.VelocityTex;
    require(!grid.data == !velocity.data, "some of the ink's grids are missing");
    if (!grid.data) return;
    require(grid.width == velocity.width && grid.height == velocity.height, "the ink's grids differ in size");
    require(grid.width >= 0 && grid.height >= 0, "a grid has a negative size");
    const auto texels = static_cast<std::uint64_t>(grid.width) * static_cast<std::uint64_t>(grid.height);
    require(owns(grid.data, sizeof(T) * texels), "a grid is smaller than its size says");
}

}  // namespace

void resetLibrary() {
    __android_log_set_logger([](const __android_log_message*) {});
    resetGestures();
    dropPicture(bmp_portrait_bg_info, bmp_portrait_bg_Pixels);
    dropPicture(bmp_landscape_bg_info, bmp_landscapebg_Pixels);
    dropPicture(bmp_water_Info, bmp_water_Pixels);
    srand48(1);
    hostModes = _mm_getcsr() & kModes;
}

void requireSoundLibrary() {
    requireSoundPicture(bmp_portrait_bg_info, bmp_portrait_bg_Pixels);
    requireSoundPicture(bmp_landscape_bg_info, bmp_landscapebg_Pixels);
    requireSoundPicture(bmp_water_Info, bmp_water_Pixels);
    requireSoundGrid(fluid.VelocityTex);
    requireSoundGrid(fluid.VelocityTexTemp);
    requireSoundGrid(fluid.PressureTex);
    requireSoundGrid(fluid.PressureTexTemp);
    requireSoundGrid(fluid.DivergenceTex);
    require((_mm_getcsr() & kModes) == hostModes, "the processor's floating-point modes have changed");

    const Texture<vec2>& flow = fluid.VelocityTex;
    if (flow.empty()) return;
    // 0 for numbers, and not a number for anything else: one test at the end, as this runs after every call.
    float zero = 0.0f;
    for (const vec2* v = flow.row(0); v != flow.row(flow.height); ++v) zero += 0.0f * v->x + 0.0f * v->y;
    require(zero == 0.0f, "the flow of the ink is not finite");
}
