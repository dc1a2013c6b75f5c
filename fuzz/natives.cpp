// Makes native calls in any order, with any arguments that a host may pass. Arrays have exactly the length that the
// counts require, which is the host's duty, so that the sanitizer detects an access beyond it. A call that would need a
// larger array than a host has is skipped.
#include <algorithm>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "fuzz/library_state.h"
#include "fuzz/require.h"
#include "fuzz/values.h"
#include "host/native_names.h"
#include "jni/globals.h"
#include "platform/desktop_bitmap.h"
#include "probes/copying_environment.h"

using namespace tidemark;

namespace {

using Wide = std::int64_t;

constexpr Wide kLongestArray = 1 << 18;   // elements
constexpr Wide kLargestBitmap = 1 << 20;  // bytes
constexpr Wide kSessionWork = 2'200'000;  // grid texels that a session may compute
constexpr int kMostCalls = 100;

Wide product(Wide a, Wide b) {
    return std::max<Wide>(a, 0) * std::max<Wide>(b, 0);
}

// An array that is occasionally null or cannot be pinned.
template <class Array>
struct Argument : Array {
    Argument(Values& drawn, Wide length) : Array(static_cast<std::size_t>(std::max<Wide>(length, 0))) {
        const int kind = drawn.below(256);
        pinnable = kind < 240;
        reference = kind < 248 ? this : nullptr;
        if constexpr (std::same_as<Array, FloatArray>) {
            if (kind >= 200) std::ranges::fill(this->values, drawn.real());
        }
    }
    Argument(const Argument&) = delete;
    Argument& operator=(const Argument&) = delete;

    bool pinnable;
    Array* reference;
};

using Floats = Argument<FloatArray>;
using Shorts = Argument<ShortArray>;

JNIEnv* const env = [] {
    static const JNINativeInterface_& host = *copyingEnvironment()->functions;
    static JNINativeInterface_ table = host;
    table.GetFloatArrayElements = [](JNIEnv* self, jfloatArray array, jboolean* isCopy) {
        return static_cast<Floats*>(array)->pinnable ? host.GetFloatArrayElements(self, array, isCopy) : nullptr;
    };
    table.GetShortArrayElements = [](JNIEnv* self, jshortArray array, jboolean* isCopy) {
        return static_cast<Shorts*>(array)->pinnable ? host.GetShortArrayElements(self, array, isCopy) : nullptr;
    };
    static JNIEnv environment = {&table};
    return &environment;
}();

Wide workLeft = 0;

// Subtracts one frame's work from the session's limit and returns whether the frame may run. The limit allows one frame
// of a 16384 x 16384 view.
bool mayCompute(Wide share = 1) {
    workLeft -= 1 + product(fluid.GridWidth, fluid.GridHeight) / share;
    return workLeft > 0;
}

std::uint32_t strideOf(Values& values, std::uint32_t width) {
    const int kind = values.below(6);
    const std::uint32_t extra = kind == 3 || kind == 4 ? static_cast<std::uint32_t>(values.below(64)) : 0;
    const std::uint32_t strides[] = {width * 4, 0, width * 2, width * 4 + extra, extra, width * 8};
    return strides[kind];
}

void transfer(Values& values) {
    constexpr void (*kTransfers[])(JNIEnv*, jobject, jobject) = {
        native::transferPortraitBGBitmap, native::transferLandscapeBGBitmap, native::transferWaterBitmap};
    const auto native = values.PickValueInArray(kTransfers);
    if (values.below(16) == 15) return native(env, nullptr, nullptr);

    DesktopBitmap bitmap;
    bitmap.info.width = static_cast<std::uint32_t>(values.number(0, 16));
    bitmap.info.height = static_cast<std::uint32_t>(values.number(0, 16));
    bitmap.info.stride = strideOf(values, bitmap.info.width);
    bitmap.info.format = values.number(1, 8);
    const bool fails = values.below(16) >= 13;
    // Only a narrow format may have a stride of less than four bytes per pixel.
    const bool isNarrow = bitmap.info.format == ANDROID_BITMAP_FORMAT_RGB_565 ||
                          bitmap.info.format == ANDROID_BITMAP_FORMAT_RGBA_4444 ||
                          bitmap.info.format == ANDROID_BITMAP_FORMAT_A_8;
    const Wide packed = Wide{bitmap.info.width} * 4;
    const Wide rowBytes = isNarrow ? std::min(packed, Wide{bitmap.info.stride}) : packed;
    const bool fits = bitmap.info.height == 0 || rowBytes <= kLargestBitmap / Wide{bitmap.info.height};
    std::vector<std::uint8_t> pixels(fits ? static_cast<std::size_t>(rowBytes * bitmap.info.height) : 0);
    pixels.reserve(1);
    // The library cannot allocate a copy beyond max_allocation_size_mb, so it must not read these pixels.
    const std::uint64_t texels = std::uint64_t{bitmap.info.width} * bitmap.info.height;
    const bool refused = texels > 1 << 24 && texels < std::uint64_t{1} << 60;
    if ((fits || refused) && !fails) bitmap.pixels = pixels.data();
    native(env, nullptr, &bitmap);
    require(bitmap.locks == 0, "a bitmap is still locked, or was unlocked twice");
}

void setUp(Values& values) {
    const int width = values.number(-12, 243);
    const int height = values.number(-12, 243);
    native::onInitSetting(env, nullptr, width, height, static_cast<jboolean>(values.below(4) > 0));
}

void setUpGpu(Values&) {
    if (mayCompute(8)) native::onInitGPU(env, nullptr);
}

void loadTextures(Values& values) {
    constexpr void (*kLoads[])(JNIEnv*, jobject) = {
        native::onLoadPortraitBGTextures, native::onLoadLandscapeBGTextures, native::onLoadWaterTextures};
    values.PickValueInArray(kLoads)(env, nullptr);
}

void makeMesh(Values& values) {
    const int columns = values.number(0, 40);
    const int rows = values.number(0, 40);
    const int vertices =
        values.below(2) ? values.number(0, 64) : static_cast<int>(product(columns, rows) % kLongestArray);
    const int width = values.number(0, 64);
    const int height = values.number(0, 64);
    const Wide floats = 3 * Wide{vertices};
    const Wide cells = product(Wide{columns} - 1, Wide{rows} - 1);
    if (floats > kLongestArray || cells > kLongestArray / 6) return;
    Floats positions(values, floats);
    Shorts indices(values, 6 * cells);
    native::initWaters(env, nullptr, positions.reference, indices.reference, vertices, width, height, columns, rows);
}

void moveWater(Values& values) {
    const int xStart = values.number(0, 4);
    const int yStart = values.number(0, 4);
    const int xEnd = values.number(0, 40);
    const int yEnd = values.number(0, 40);
    const int stride = values.number(0, 48);
    const int rowCount = values.number(0, 40);
    const auto checkCalm = static_cast<jboolean>(values.below(2));
    const float damping = values.real();
    const float waveSpeed = values.real();
    Wide length = 0;
    if (xStart < xEnd && yStart < yEnd) {
        // The region and the next vertex on each side of it.
        const Wide top = Wide{yStart} * stride;
        const Wide bottom = (Wide{yEnd} - 1) * stride;
        const auto [first, last] = std::minmax(
            {top - stride + xStart, top - stride + xEnd - 1, top + xStart - 1, top + xEnd, bottom + xStart - 1,
             bottom + xEnd, bottom + stride + xStart, bottom + stride + xEnd - 1});
        if (first < 0 || last >= kLongestArray || Wide{yEnd} - yStart > kLongestArray / (Wide{xEnd} - xStart)) return;
        length = last + 1;
    }
    Floats velocity(values, length);
    Floats height(values, length);
    native::move(
        env, nullptr, velocity.reference, height.reference, xStart, yStart, xEnd, yEnd, stride, rowCount, checkCalm,
        damping, waveSpeed);
}

void ripple(Values& values) {
    const int extentA = values.number(0, 64);
    const int extentB = values.number(0, 64);
    const int countA = values.number(0, 64);
    const int countB = values.number(0, 64);
    const float posA = values.real();
    const float posB = values.real();
    const float amplitude = values.real();
    if (product(countA, countB) > kLongestArray) return;
    Floats field(values, product(countA, countB));
    native::ripple(env, nullptr, field.reference, extentA, extentB, countA, countB, posA, posB, amplitude);
}

void touch(Values& values) {
    const int x = values.number(-10, 245);
    const int y = values.number(-10, 245);
    const int action = values.number(0, 3);
    native::onTouch(env, nullptr, x, y, action, values.real());
}

// Draws up to 16 frames, because a tap lasts for 13.
void draw(Values& values) {
    const int frames = values.below(16) + 1;
    const int positionFloats = values.number(0, 255);
    const int heightFloats = values.number(0, 255);
    const int indexCount = values.number(0, 255);
    int sizes[4];
    for (int& size : sizes) size = values.number(0, 64);
    float look[10];
    for (float& value : look) value = values.real();
    const auto landscape = static_cast<jboolean>(values.below(2));
    if (std::max({positionFloats, heightFloats, indexCount}) > kLongestArray) return;
    Floats positions(values, positionFloats);
    Floats heights(values, heightFloats);
    Shorts indices(values, indexCount);
    Floats mvp(values, 16);
    for (int frame = 0; frame < frames && mayCompute(); ++frame) {
        native::onDrawFrame(
            env, nullptr, positions.reference, heights.reference, indices.reference, positionFloats, heightFloats,
            indexCount, mvp.reference, sizes[0], sizes[1], sizes[2], sizes[3], look[0], look[1], look[2], look[3],
            look[4], look[5], look[6], look[7], look[8], look[9], landscape);
        requireValidState();
    }
}

void clearInk(Values&) {
    native::clearInkValue(env, nullptr);
}

void queryInk(Values&) {
    const int shown = native::getClearInkValue(env, nullptr);
    require(shown == 0 || shown == 1, "the ink is neither shown nor hidden");
}

constexpr void (*kCalls[])(Values&) = {transfer, setUp, setUpGpu, loadTextures, makeMesh, moveWater,
                                       ripple,   touch, draw,     clearInk,     queryInk};

}  // namespace

// Allocations beyond a phone's memory fail at once. Uninitialized memory is filled with 0xff, which is NaN as a float.
extern "C" const char* __asan_default_options() {
    return "allocator_may_return_null=1:max_allocation_size_mb=64:quarantine_size_mb=16"
           ":max_malloc_fill_size=1048576:malloc_fill_byte=255";
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    resetLibrary();
    workLeft = kSessionWork;
    Values values(data, size);
    for (int calls = 0; calls < kMostCalls && values.remaining_bytes() > 0; ++calls) {
        values.PickValueInArray(kCalls)(values);
        require(pinnedCopies == 0, "an array is still pinned, or was released twice");
        requireValidState();
    }
    return 0;
}
