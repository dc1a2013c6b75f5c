#include "jni/bitmaps.h"

#include <cstddef>
#include <cstdlib>
#include <cstring>

#include "base/log.h"

AndroidBitmapInfo bmp_portrait_bg_info;
AndroidBitmapInfo bmp_landscape_bg_info;
AndroidBitmapInfo bmp_water_Info;
std::uint8_t* bmp_portrait_bg_Pixels;
std::uint8_t* bmp_landscapebg_Pixels;
std::uint8_t* bmp_water_Pixels;

namespace {

// Frees the copies when the library unloads.
const struct CopyOwner {
    ~CopyOwner() {
        std::free(bmp_portrait_bg_Pixels);
        std::free(bmp_landscapebg_Pixels);
        std::free(bmp_water_Pixels);
    }
} copyOwner;

}  // namespace

void transferBitmap(JNIEnv* env, jobject bitmap, AndroidBitmapInfo& info, std::uint8_t*& pixels) {
    AndroidBitmapInfo handed = {};
    int result = AndroidBitmap_getInfo(env, bitmap, &handed);
    if (result < 0) {
        LOG_ERROR("AndroidBitmap_getInfo () failed! error = % d", result);  // By contract "% d".
        return;
    }
    // Formats of fewer than 32 bits have shorter rows, beyond which we would read. A platform that does not tell is
    // trusted.
    if (handed.stride && handed.stride / 4 < handed.width) {
        LOG_ERROR("not a 32-bit bitmap: %u bytes for %u pixels", handed.stride, handed.width);
        return;
    }
    void* locked = nullptr;
    result = AndroidBitmap_lockPixels(env, bitmap, &locked);
    if (result < 0) {
        LOG_ERROR("AndroidBitmap_lockPixels () failed! error = % d", result);
        return;
    }
    // Copied, not kept locked: a host that recycles its bitmap early cannot pull the pixels from under us, and
    // after a lost context the textures are loaded again without another hand-over. Costs one picture of memory. The
    // size is stored together with the copy, so that it never belongs to other pixels.
    const std::uint64_t wanted = std::uint64_t{handed.width} * handed.height * 4;
    const auto bytes = static_cast<std::size_t>(wanted);
    void* const copy = locked && wanted == bytes ? std::realloc(pixels, bytes ? bytes : 1) : nullptr;
    if (copy) {
        pixels = static_cast<std::uint8_t*>(copy);
        info = handed;
        std::memcpy(pixels, locked, bytes);
    } else {
        LOG_ERROR("cannot copy a bitmap of %u x %u", handed.width, handed.height);
    }
    AndroidBitmap_unlockPixels(env, bitmap);
}
