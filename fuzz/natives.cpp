// Sessions of native calls in any order, with any arguments that a host can pass. Arrays have the length that the
// counts ask for, which is the host's duty; where that is more than any host has, the call is left out.
#include <algorithm>
#include <concepts>
#include <cstddef>
#include <cstdint>
#include <iterator>

#include "fuzz/checked_bitmap.h"
#include "fuzz/checked_jni.h"
#include "fuzz/library_state.h"
#include "fuzz/require.h"
#include "fuzz/values.h"
#include "host/native_names.h"
#include "jni/globals.h"

namespace {

using Wide = std::int64_t;

constexpr Wide kLongestArray = 1 << 18;   // elements
constexpr Wide kLargestBitmap = 1 << 20;  // bytes
constexpr Wide kSessionWork = 2'200'000;  // texels that the ink may compute in one session
constexpr int kMostCalls = 100;

Wide product(Wide a, Wide b) {
    return std::max<Wide>(a, 0) * std::max<Wide>(b, 0);
}

JNIEnv* const env = checkedEnvironment();
Wide workLeft = 0;

// Whether a session has room for one more frame on the grids; with a view of 16384 x 16384 it has it once.
bool mayCompute(Wide share = 1) {
    workLeft -= 1 + product(fluid.GridWidth, fluid.GridHeight) / share;
    return workLeft > 0;
}

// Usually there, now and then null or without memory for its pin.
template <class Array>
struct Argument {
    Argument(Values& values, Wide length) {
        const int kind = values.below(256);
        array.length = static_cast<std::size_t>(std::max<Wide>(length, 0));
        array.pinnable = kind < 240;
        reference = kind < 248 ? &array : nullptr;
        if constexpr (std::same_as<Array, CheckedFloats>) array.content = kind >= 200 ? values.real() : 0.0f;
    }
    Argument(const Argument&) = delete;
    Argument& operator=(const Argument&) = delete;

    Array array;
    Array* reference;
};

using Floats = Argument<CheckedFloats>;
using Shorts = Argument<CheckedShorts>;

std::uint32_t strideOf(Values& values, std::uint32_t width) {
    switch (values.below(6)) {
        case 0:
            return width * 4;
        case 1:
            return 0;
        case 2:
            return width * 2;
        case 3:
            return width * 4 + static_cast<std::uint32_t>(values.below(64));
        case 4:
            return static_cast<std::uint32_t>(values.below(64));
        default:
            return width * 8;
    }
}

void transfer(Values& values) {
    using Transfer = void (*)(JNIEnv*, jobject, jobject);
    const Transfer transfers[] = {
        NATIVE(transferPortraitBGBitmap), NATIVE(transferLandscapeBGBitmap), NATIVE(transferWaterBitmap)};
    const Transfer native = values.PickValueInArray(transfers);
    if (values.below(16) == 15) return native(env, nullptr, nullptr);

    CheckedBitmap bitmap;
    bitmap.info.width = static_cast<std::uint32_t>(values.number(0, 16));
    bitmap.info.height = static_cast<std::uint32_t>(values.number(0, 16));
    bitmap.info.stride = strideOf(values, bitmap.info.width);
    bitmap.info.format = values.number(1, 8);
    const int failure = values.below(16);
    if (failure == 13) bitmap.infoResult = ANDROID_BITMAP_RESULT_JNI_EXCEPTION;
    if (failure == 14) bitmap.lockResult = ANDROID_BITMAP_RESULT_JNI_EXCEPTION;
    // A stride of 0 says that the rows are packed.
    const Wide rowBytes = bitmap.info.stride ? Wide{bitmap.info.stride} : Wide{bitmap.info.width} * 4;
    const bool fits = bitmap.info.height == 0 || rowBytes <= kLargestBitmap / Wide{bitmap.info.height};
    if (!fits) bitmap.lockResult = ANDROID_BITMAP_RESULT_ALLOCATION_FAILED;
    if (fits && failure != 15) {
        bitmap.pixels.reset(new std::uint8_t[static_cast<std::size_t>(rowBytes * bitmap.info.height)]());
    }
    native(env, nullptr, &bitmap);
    require(bitmap.locks == 0, "a bitmap is still locked");
}

void setUp(Values& values) {
    const int width = values.number(-12, 243);
    const int height = values.number(-12, 243);
    NATIVE(onInitSetting)(env, nullptr, width, height, static_cast<jboolean>(values.below(4) > 0));
}

void setUpGpu(Values&) {
    if (!mayCompute(8)) return;
    NATIVE(onInitGPU)(env, nullptr);
}

void loadTextures(Values& values) {
    const int which = values.below(3);
    if (which == 0) NATIVE(onLoadPortraitBGTextures)(env, nullptr);
    if (which == 1) NATIVE(onLoadLandscapeBGTextures)(env, nullptr);
    if (which == 2) NATIVE(onLoadWaterTextures)(env, nullptr);
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
    NATIVE(initWaters)
    (env, nullptr, positions.reference, indices.reference, vertices, width, height, columns, rows);
}

// The elements of a field that a wave step may touch: its region and the next vertex on each side of it.
struct Reach {
    Wide first, last;
};

Reach reachOf(Wide xStart, Wide yStart, Wide xEnd, Wide yEnd, Wide stride) {
    const Wide corners[] = {(yStart - 1) * stride + xStart,   (yStart - 1) * stride + xEnd - 1, yEnd * stride + xStart,
                            yEnd * stride + xEnd - 1,         yStart * stride + xStart - 1,     yStart * stride + xEnd,
                            (yEnd - 1) * stride + xStart - 1, (yEnd - 1) * stride + xEnd};
    return {
        *std::min_element(std::begin(corners), std::end(corners)),
        *std::max_element(std::begin(corners), std::end(corners))};
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
        const Reach reach = reachOf(xStart, yStart, xEnd, yEnd, stride);
        const Wide columns = Wide{xEnd} - xStart;
        const Wide rows = Wide{yEnd} - yStart;
        if (reach.first < 0 || reach.last >= kLongestArray || rows > kLongestArray / columns) return;
        length = reach.last + 1;
    }
    Floats velocity(values, length);
    Floats height(values, length);
    NATIVE(move)
    (env, nullptr, velocity.reference, height.reference, xStart, yStart, xEnd, yEnd, stride, rowCount, checkCalm,
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
    if (countA > 0 && countB > 0 && countA > kLongestArray / countB) return;
    Floats field(values, product(countA, countB));
    NATIVE(ripple)(env, nullptr, field.reference, extentA, extentB, countA, countB, posA, posB, amplitude);
}

void touch(Values& values) {
    const int x = values.number(-10, 245);
    const int y = values.number(-10, 245);
    const int action = values.number(0, 3);
    NATIVE(onTouch)(env, nullptr, x, y, action, values.real());
}

// One frame or several, as a tap lasts for a dozen.
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
        NATIVE(onDrawFrame)
        (env, nullptr, positions.reference, heights.reference, indices.reference, positionFloats, heightFloats,
         indexCount, mvp.reference, sizes[0], sizes[1], sizes[2], sizes[3], look[0], look[1], look[2], look[3], look[4],
         look[5], look[6], look[7], look[8], look[9], landscape);
        requireNothingPinned();
        requireSoundLibrary();
    }
}

void clearInk(Values&) {
    NATIVE(clearInkValue)(env, nullptr);
}

void askForInk(Values&) {
    const int shown = NATIVE(getClearInkValue)(env, nullptr);
    require(shown == 0 || shown == 1, "the ink is neither shown nor hidden");
}

using Call = void (*)(Values&);
constexpr Call kCalls[] = {transfer, setUp, setUpGpu, loadTextures, makeMesh, moveWater,
                           ripple,   touch, draw,     clearInk,     askForInk};

}  // namespace

// Grids that a phone has no memory for are refused at once instead of filling this machine's. What nobody has written
// is not a number.
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
        requireNothingPinned();
        requireSoundLibrary();
    }
    return 0;
}
