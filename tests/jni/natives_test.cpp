#include "jni/natives.h"

#include <gtest/gtest.h>

#include <cstring>
#include <initializer_list>
#include <utility>
#include <vector>

#include "fluid/fluid.h"
#include "host/host_jni.h"
#include "host/native_names.h"
#include "host/water_host.h"
#include "jni/bitmaps.h"
#include "jni/globals.h"
#include "platform/desktop_bitmap.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tests/support/test_pictures.h"

namespace {

struct Slot {
    void (*transfer)(JNIEnv*, jobject, jobject);
    AndroidBitmapInfo& info;
    std::uint8_t*& pixels;
};

const Slot kSlots[] = {
    {NATIVE(transferPortraitBGBitmap), bmp_portrait_bg_info, bmp_portrait_bg_Pixels},
    {NATIVE(transferLandscapeBGBitmap), bmp_landscape_bg_info, bmp_landscapebg_Pixels},
    {NATIVE(transferWaterBitmap), bmp_water_Info, bmp_water_Pixels},
};

DesktopBitmap bitmapOf(std::vector<std::uint8_t>& pixels, std::uint32_t width, std::uint32_t height) {
    DesktopBitmap bitmap;
    bitmap.info.width = width;
    bitmap.info.height = height;
    bitmap.pixels = pixels.data();
    return bitmap;
}

}  // namespace

TEST(BitmapHandOver, keepsThePixelsOfABitmapThatIsRecycledAtOnce) {
    for (const Slot& slot : kSlots) {
        std::vector<std::uint8_t> pixels(2 * 3 * 4);
        for (std::size_t i = 0; i < pixels.size(); ++i) pixels[i] = static_cast<std::uint8_t>(i * 7);
        const auto original = pixels;
        DesktopBitmap bitmap = bitmapOf(pixels, 2, 3);
        slot.transfer(hostEnvironment(), nullptr, &bitmap);
        EXPECT_EQ(bitmap.locks, 0);
        pixels.assign(pixels.size(), 0);
        EXPECT_EQ(slot.info.height, 3u);
        EXPECT_EQ(std::memcmp(slot.pixels, original.data(), original.size()), 0);
    }
}

TEST(BitmapHandOver, aFailureIsLoggedAndLeavesTheSlotAlone) {
    for (const Slot& slot : kSlots) {
        std::vector<std::uint8_t> pixels(4 * 4 * 4, 9);
        DesktopBitmap bitmap = bitmapOf(pixels, 4, 4);
        slot.transfer(hostEnvironment(), nullptr, &bitmap);
        const std::uint8_t* const stored = slot.pixels;

        LogRecorder log;
        slot.transfer(hostEnvironment(), nullptr, nullptr);
        EXPECT_EQ(log.take(), std::vector<std::string>{"E AndroidBitmap_getInfo () failed! error = -1"});
        DesktopBitmap unlockable;
        unlockable.info.width = 1000;
        slot.transfer(hostEnvironment(), nullptr, &unlockable);
        EXPECT_EQ(log.take(), std::vector<std::string>{"E AndroidBitmap_lockPixels () failed! error = -3"});
        EXPECT_EQ(unlockable.locks, 0);
        DesktopBitmap narrow = bitmapOf(pixels, 8, 4);
        narrow.info.stride = 2 * 8;
        slot.transfer(hostEnvironment(), nullptr, &narrow);
        EXPECT_EQ(log.take(), std::vector<std::string>{"E not a 32-bit bitmap: 16 bytes for 8 pixels"});
        EXPECT_EQ(slot.pixels, stored);
        EXPECT_EQ(slot.info.width, 4u) << "the size always belongs to the pixels";
    }
}

TEST(MeshNatives, workOnTheHostsArraysInPlace) {
    JNIEnv* const env = hostEnvironment();
    FloatArray positions(12);
    ShortArray indices(6);
    NATIVE(initWaters)(env, nullptr, &positions, &indices, 4, 2, 2, 2, 2);
    EXPECT_EQ(positions.values, (std::vector<float>{-1, 1, 0, -1, -1, 0, 1, 1, 0, 1, -1, 0}));
    EXPECT_EQ(indices.values, (std::vector<jshort>{0, 1, 3, 0, 3, 2}));

    // A virtual machine may have no address for an array without elements.
    JNINativeInterface_ functions = *env->functions;
    functions.GetFloatArrayElements = [](JNIEnv*, jfloatArray, jboolean*) -> jfloat* { return nullptr; };
    JNIEnv sparing = {&functions};
    FloatArray none(0);
    ShortArray cells(6);
    NATIVE(initWaters)(&sparing, nullptr, &none, &cells, 0, 2, 2, 2, 2);
    EXPECT_EQ(cells.values, indices.values);
    functions = *env->functions;
    functions.GetShortArrayElements = [](JNIEnv*, jshortArray, jboolean*) -> jshort* { return nullptr; };
    FloatArray one(3);
    ShortArray noCells(0);
    NATIVE(initWaters)(&sparing, nullptr, &one, &noCells, 1, 2, 2, 3, 1);
    EXPECT_EQ(one.values[0], -1.0f);

    FloatArray velocity(8 * 8);
    FloatArray height(8 * 8);
    NATIVE(ripple)(env, nullptr, &velocity, 8, 8, 8, 8, 0.0f, 0.0f, 0.5f);
    EXPECT_EQ(velocity.values[4 * 8 + 4], 1.5f);
    const auto move = [&](jboolean check) {
        return NATIVE(move)(env, nullptr, &velocity, &height, 1, 1, 7, 7, 8, 8, check, 0.5f, 0.0f);
    };
    EXPECT_EQ(move(JNI_TRUE), JNI_FALSE);
    EXPECT_EQ(velocity.values[4 * 8 + 4], 0.75f);
    EXPECT_GT(height.values[4 * 8 + 4], 0.5f);
    EXPECT_EQ(move(JNI_FALSE), JNI_TRUE);
}

using Natives = GlTest;

TEST_F(Natives, aWholeRunOfTheWaterLogsTheStatedLinesAndDraws) {
    resetGestures();
    WaterHost host(Look{}, kSide, kSide, 1);
    host.handOver({smoothPicture(30, 30, 1), smoothPicture(30, 30, 2), smoothPicture(8, 8, 3)});
    host.setUp(false);
    auto lines = log.take();
    const std::vector<std::string> wanted = {"I onInitSetting",          "I InitializeSetting",
                                             "I InitializeGPU",          "I onLoadPortraitBGTextures",
                                             "I LoadPortraitBGTextures", "I onLoadLandscapeBGTextures",
                                             "I LoadLandscapeBGTextures"};
    std::erase_if(
        lines, [&wanted](const auto& line) { return std::find(wanted.begin(), wanted.end(), line) == wanted.end(); });
    EXPECT_EQ(lines, wanted);
    EXPECT_EQ(SCREEN_WIDTH, kSide);
    EXPECT_FALSE(bWithInk);

    glViewport(0, 0, 5, 5);
    host.draw();
    const auto flat = readPixels();
    EXPECT_GT(flat[0][0] + flat[0][1], 60) << "something of the picture, in the corner too";
    host.touch(TouchAction::down, kSide / 2, kSide / 2, 1.0f);
    ASSERT_TRUE(host.advance(0.1));
    host.draw();
    EXPECT_NE(readPixels(), flat);
    EXPECT_TRUE(log.take().empty()) << "a frame logs nothing";
}

TEST_F(Natives, aFrameReleasesEveryArrayAndMovesTheInkOnlyWithIt) {
    resetGestures();
    FloatArray positions(12);
    FloatArray heights(12);
    FloatArray mvp(16);
    ShortArray indices(6);
    for (const bool ink : {false, true}) {
        NATIVE(onInitSetting)(hostEnvironment(), nullptr, kSide, kSide, ink);
        NATIVE(onInitGPU)(hostEnvironment(), nullptr);
        NATIVE(onTouch)(hostEnvironment(), nullptr, 30, 30, 0, 1.0f);
        NATIVE(onDrawFrame)
        (hostEnvironment(), nullptr, &positions, &heights, &indices, 12, 12, 6, &mvp, 2, 2, 2, 2, 1.3f, 0.5f, 0.5f,
         1.0f, 0.1f, 0.2f, 0.3f, 1.0f, 1.0f, 1.0f, JNI_FALSE);
        EXPECT_EQ(positions.pins + heights.pins + mvp.pins + indices.pins, 0);
        EXPECT_EQ(count, ink ? 1 : 0);
        EXPECT_EQ(fluid.InkColor.r, ink ? static_cast<float>(double{0.1f} + 0.05) : 1.0f);
        EXPECT_EQ(fluid.InkColor.b, ink ? static_cast<float>(double{0.3f} + 0.05) : 1.0f);
    }
}

TEST_F(Natives, clearingTheInkEndsTheGesture) {
    resetGestures();
    fluid.ClearInkValue = 1.9f;
    EXPECT_EQ(NATIVE(getClearInkValue)(hostEnvironment(), nullptr), 1) << "truncated";
    state = 2;
    step = 7;
    fluid.DensityDissipation = 0.9f;
    fluid.DragMode = 2;
    NATIVE(clearInkValue)(hostEnvironment(), nullptr);
    EXPECT_EQ(state, 0);
    EXPECT_EQ(step, 0);
    EXPECT_EQ(fluid.DensityDissipation, 0.0f);
    EXPECT_EQ(fluid.DragMode, 0);
    EXPECT_EQ(NATIVE(getClearInkValue)(hostEnvironment(), nullptr), 0);
}

TEST_F(Natives, everyArrayIsPinnedAndCopiedBackInTheOrderOfTheContract) {
    static std::vector<std::pair<const void*, int>> calls;  // the array, and the mode of its release or -1 for its pin
    static JNINativeInterface_ table = *hostEnvironment()->functions;
    table.GetFloatArrayElements = [](JNIEnv*, jfloatArray array, jboolean* isCopy) {
        calls.emplace_back(array, isCopy ? -2 : -1);
        return hostEnvironment()->GetFloatArrayElements(array, nullptr);
    };
    table.GetShortArrayElements = [](JNIEnv*, jshortArray array, jboolean* isCopy) {
        calls.emplace_back(array, isCopy ? -2 : -1);
        return hostEnvironment()->GetShortArrayElements(array, nullptr);
    };
    table.ReleaseFloatArrayElements = [](JNIEnv*, jfloatArray array, jfloat* elements, jint mode) {
        calls.emplace_back(array, mode);
        hostEnvironment()->ReleaseFloatArrayElements(array, elements, mode);
    };
    table.ReleaseShortArrayElements = [](JNIEnv*, jshortArray array, jshort* elements, jint mode) {
        calls.emplace_back(array, mode);
        hostEnvironment()->ReleaseShortArrayElements(array, elements, mode);
    };
    JNIEnv env = {&table};
    FloatArray positions(12), heights(4), attribs(12), mvp(16), velocity(4);
    ShortArray indices(6);
    const auto expectOrder = [](std::initializer_list<const void*> arrays) {
        decltype(calls) expected;
        for (const int what : {-1, 0}) {
            for (const void* array : arrays) expected.emplace_back(array, what);
        }
        EXPECT_EQ(calls, expected);
        calls.clear();
    };
    NATIVE(initWaters)(&env, nullptr, &positions, &indices, 4, 1, 1, 2, 2);
    expectOrder({&positions, &indices});
    NATIVE(move)(&env, nullptr, &velocity, &heights, 0, 0, 0, 0, 2, 2, true, 0.9f, 0.3f);
    expectOrder({&velocity, &heights});
    NATIVE(onDrawFrame)
    (&env, nullptr, &positions, &attribs, &indices, 12, 12, 6, &mvp, 1, 1, 2, 2, 1.33f, 0.5f, 0.5f, 1.0f, 0.0f, 0.0f,
     0.0f, 1.0f, 1.0f, 40.0f, false);
    expectOrder({&positions, &attribs, &mvp, &indices});
}
