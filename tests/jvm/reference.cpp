// Makes in C++ the calls that WholeRunTest causes examples/minimal-java/MinimalWater.java to make. Writes the pictures,
// the frames and the log to files, with which WholeRunTest compares its own.
#include <GLES2/gl2.h>

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <fstream>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "desktop/headless_context.h"
#include "host/host_jni.h"
#include "host/native_names.h"
#include "platform/desktop_bitmap.h"
#include "probes/smooth_picture.h"
#include "tests/support/log_recorder.h"

using namespace tidemark;

namespace {

constexpr int kN = 128;
constexpr int kExtent = 32;

JNIEnv* const env = hostEnvironment();
std::string directory;
FloatArray positions(3 * kN * kN), heights(kN*kN), velocity(kN*kN), attribs(3 * kN * kN), mvp(16);
ShortArray indices(6 * (kN - 1) * (kN - 1));
float visibleWidth, visibleHeight;
int width, height;

void write(const std::string& name, const void* data, std::size_t bytes) {
    std::ofstream(directory + name, std::ios::binary)
        .write(static_cast<const char*>(data), static_cast<std::streamsize>(bytes));
}

void handOver(void (*transfer)(JNIEnv*, jobject, jobject), const char* name, int w, int h, int variant) {
    Picture picture = smoothPicture(w, h, variant);
    write(name, picture.rgba.data(), picture.rgba.size());
    DesktopBitmap bitmap;
    bitmap.info = {
        static_cast<uint32_t>(w), static_cast<uint32_t>(h), static_cast<uint32_t>(4 * w),
        ANDROID_BITMAP_FORMAT_RGBA_8888, 0};
    bitmap.pixels = picture.rgba.data();
    transfer(env, nullptr, &bitmap);
}

void setUp(int w, int h) {
    width = w;
    height = h;
    handOver(native::transferPortraitBGBitmap, "portrait", 90, 160, 1);
    handOver(native::transferLandscapeBGBitmap, "landscape", 160, 90, 2);
    handOver(native::transferWaterBitmap, "light", 64, 64, 3);
    native::onInitSetting(env, nullptr, w, h, JNI_TRUE);
    native::onInitGPU(env, nullptr);
    native::onLoadPortraitBGTextures(env, nullptr);
    native::onLoadLandscapeBGTextures(env, nullptr);
    native::onLoadWaterTextures(env, nullptr);
    native::initWaters(env, nullptr, &positions, &indices, kN * kN, kExtent, kExtent, kN, kN);
    visibleWidth = static_cast<float>(kExtent * w) / static_cast<float>(std::max(w, h));
    visibleHeight = static_cast<float>(kExtent * h) / static_cast<float>(std::max(w, h));
    mvp.values = {2.0f / visibleWidth, 0, 0, 0, 0, 2.0f / visibleHeight, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
}

void draw() {
    for (std::size_t i = 0; i < kN * kN; ++i) {
        attribs.values[3 * i] = heights.values[i];
        attribs.values[3 * i + 1] = heights.values[i + kN < kN * kN ? i + kN : i];
        attribs.values[3 * i + 2] = heights.values[i % kN > 0 ? i - 1 : i];
    }
    const auto extent = [](float visible) { return static_cast<jint>(std::ceil(visible * 1.015f)); };
    native::onDrawFrame(
        env, nullptr, &positions, &attribs, &indices, 3 * kN * kN, 3 * kN * kN, 6 * (kN - 1) * (kN - 1), &mvp,
        extent(visibleWidth), extent(visibleHeight), kN, kN, 1.75f, 0.5f, 0.7f, 1.0f, 0.05f, 0.15f, 0.45f, 0.8f, 4.5f,
        40.0f, width > height);
}

void frame() {
    native::move(env, nullptr, &velocity, &heights, 1, 1, kN - 1, kN - 1, kN, kN, JNI_FALSE, 0.985f, 0.3f);
    draw();
}

void touch(int x, int y, int action, float pressure) {
    native::onTouch(env, nullptr, x, y, action, pressure);
    const auto place = [](int at, int side, float visible) {
        return (static_cast<float>(at) - 0.5f * static_cast<float>(side)) / static_cast<float>(side) * visible;
    };
    const float size = pressure * (action == 0 ? 2.0f : action == 2 ? 0.25f : 0.0f);
    native::ripple(
        env, nullptr, &heights, kExtent, kExtent, kN, kN, place(y, height, visibleHeight),
        place(x, width, visibleWidth), size);
}

void keep(const char* name) {
    static std::set<std::vector<std::uint8_t>> kept;
    std::vector<std::uint8_t> pixels(4 * static_cast<std::size_t>(width * height));
    glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
    write(name, pixels.data(), pixels.size());
    if (!kept.insert(pixels).second) std::exit(1);  // equal to an earlier frame
}

void expectInk(int shown) {
    if (native::getClearInkValue(env, nullptr) != shown) std::exit(2);
}

}  // namespace

int main(int, char** argv) {
    directory = std::string(argv[1]) + '/';
    LogRecorder log;
    std::string error;
    std::unique_ptr<HeadlessContext> context = HeadlessContext::create(160, 160, error);
    setUp(90, 160);
    draw();
    keep("still");
    touch(30, 40, 0, 1.0f);
    for (int i = 1; i <= 30; ++i) {
        touch(30 + i, 40 + 2 * i, 2, 1.0f);
        frame();
    }
    keep("stroke");
    expectInk(1);
    touch(60, 100, 1, 0.5f);
    for (int i = 0; i < 10; ++i) frame();
    keep("lifted");
    native::clearInkValue(env, nullptr);
    frame();
    keep("cleared");
    expectInk(0);
    context.reset();
    context = HeadlessContext::create(160, 160, error);
    setUp(160, 90);
    touch(45, 45, 0, 1.0f);
    for (int i = 0; i < 10; ++i) frame();
    keep("turned");
    std::string lines;
    for (const std::string& line : log.take()) lines += line + '\n';
    write("log", lines.data(), lines.size());
}
