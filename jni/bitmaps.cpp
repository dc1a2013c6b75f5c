#include "jni/bitmaps.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>

#include "base/log.h"

AndroidBitmapInfo bmp_portrait_bg_info;
AndroidBitmapInfo bmp_landscape_bg_info;
AndroidBitmapInfo bmp_water_Info;
std::uint8_t* bmp_portrait_bg_Pixels;
std::uint8_t* bmp_landscapebg_Pixels;
std::uint8_t* bmp_water_Pixels;

BitmapSlot portraitSlot = {bmp_portrait_bg_info, bmp_portrait_bg_Pixels};
BitmapSlot landscapeSlot = {bmp_landscape_bg_info, bmp_landscapebg_Pixels};
BitmapSlot waterSlot = {bmp_water_Info, bmp_water_Pixels};

namespace {

// Frees the copies when the library unloads.
const struct CopyOwner {
    ~CopyOwner() {
        std::free(bmp_portrait_bg_Pixels);
        std::free(bmp_landscapebg_Pixels);
        std::free(bmp_water_Pixels);
    }
} copyOwner;

// Returns the size of an RGBA8 texture in bytes, or SIZE_MAX if no allocation can be that large.
std::size_t textureBytes(const AndroidBitmapInfo& info) {
    const std::uint64_t texels = std::uint64_t{info.width} * info.height;
    return texels < SIZE_MAX / 4 ? static_cast<std::size_t>(texels) * 4 : SIZE_MAX;
}

// Returns how many of the locked bytes may be read. By contract stride and format do not affect the upload, but a
// bitmap of an 8-bit or 16-bit format is shorter than its RGBA8 size, and reading beyond its end may crash.
std::size_t lockedBytes(const AndroidBitmapInfo& info) {
    const bool isNarrow = info.format == ANDROID_BITMAP_FORMAT_RGB_565 ||
                          info.format == ANDROID_BITMAP_FORMAT_RGBA_4444 || info.format == ANDROID_BITMAP_FORMAT_A_8;
    const std::uint64_t bytes = std::uint64_t{info.stride} * info.height;
    return isNarrow && info.stride / 4 < info.width ? static_cast<std::size_t>(std::min<std::uint64_t>(bytes, SIZE_MAX))
                                                    : SIZE_MAX;
}

void drop(BitmapSlot& slot) {
    std::free(slot.pixels);
    slot.pixels = nullptr;
    slot.bytes = 0;
}

// Resizes the copy to `bytes` and sets everything after its first `kept` bytes to 0. Returns false if the allocation
// fails; the slot then keeps its pixels if they are at least `bytes`, else it has none.
bool resize(BitmapSlot& slot, std::size_t bytes, std::size_t kept) {
    void* const block = bytes < SIZE_MAX ? std::realloc(slot.pixels, std::max<std::size_t>(bytes, 1)) : nullptr;
    if (!block) {
        LOG_ERROR("cannot copy a bitmap of %u x %u", slot.info.width, slot.info.height);
        if (slot.bytes < bytes) drop(slot);
        return false;
    }
    slot.pixels = static_cast<std::uint8_t*>(block);
    std::memset(slot.pixels + kept, 0, bytes - kept);
    slot.bytes = bytes;
    return true;
}

}  // namespace

void transferBitmap(JNIEnv* env, jobject bitmap, BitmapSlot& slot) {
    int result = AndroidBitmap_getInfo(env, bitmap, &slot.info);
    void* locked = nullptr;
    if (result < 0) {
        LOG_ERROR("AndroidBitmap_getInfo () failed! error = % d", result);  // By contract "% d".
    } else {
        result = AndroidBitmap_lockPixels(env, bitmap, &locked);
        if (result < 0) LOG_ERROR("AndroidBitmap_lockPixels () failed! error = % d", result);
    }
    const std::size_t bytes = textureBytes(slot.info);
    if (result < 0) {
        // The platform has already written the new size, which may need more pixels than the slot has.
        if (slot.pixels && slot.bytes < bytes) resize(slot, bytes, slot.bytes);
        return;
    }
    // The copy lets the host recycle its bitmap at once and reload the textures after a context loss without passing
    // the bitmap again.
    if (locked) {
        const std::size_t copied = std::min(bytes, lockedBytes(slot.info));
        if (resize(slot, bytes, copied)) std::memcpy(slot.pixels, locked, copied);
    } else {
        drop(slot);
    }
    AndroidBitmap_unlockPixels(env, bitmap);
}
