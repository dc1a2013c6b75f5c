#include "host/water_host.h"

#include <algorithm>
#include <cmath>

#include "host/native_names.h"
#include "platform/desktop_bitmap.h"

namespace {

void handOverOne(void (*transfer)(JNIEnv*, jobject, jobject), const Picture& picture) {
    DesktopBitmap bitmap;
    bitmap.info.width = static_cast<std::uint32_t>(picture.width);
    bitmap.info.height = static_cast<std::uint32_t>(picture.height);
    bitmap.info.stride = bitmap.info.width * 4;
    bitmap.info.format = ANDROID_BITMAP_FORMAT_RGBA_8888;
    bitmap.pixels = const_cast<std::uint8_t*>(picture.rgba.data());
    transfer(hostEnvironment(), nullptr, &bitmap);
}

std::size_t vertexCount(const Look& look) {
    return static_cast<std::size_t>(look.meshVertices) * static_cast<std::size_t>(look.meshVertices);
}

std::size_t indexCount(const Look& look) {
    const auto cells = static_cast<std::size_t>(look.meshVertices) - 1;
    return 6 * cells * cells;
}

}  // namespace

WaterHost::WaterHost(const Look& look, int width, int height, std::uint32_t seed)
    : look_(look),
      random_(seed),
      calmSteps_(look.stepsToRest),
      positions_(3 * vertexCount(look)),
      indices_(indexCount(look)),
      velocity_(vertexCount(look)),
      heights_(vertexCount(look)),
      heightAttribs_(3 * vertexCount(look)),
      mvp_(16) {
    resize(width, height);
}

void WaterHost::resize(int width, int height) {
    width_ = width;
    height_ = height;
    // The mesh is a square around the view, so that its cells are squares on the screen and rings stay round. The
    // view shows the middle of it.
    const auto extent = static_cast<float>(look_.meshExtent);
    const float pixel = extent / look_.pictureZoom / static_cast<float>(std::max(width, height));
    visibleWidth_ = pixel * static_cast<float>(width);
    visibleHeight_ = pixel * static_cast<float>(height);
    pictureWidth_ = static_cast<int>(std::ceil(visibleWidth_));
    pictureHeight_ = static_cast<int>(std::ceil(visibleHeight_));
    mvp_.values = {2.0f / visibleWidth_, 0, 0, 0, 0, 2.0f / visibleHeight_, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
    changed_ = true;
}

double WaterHost::proportions() const {
    const auto [shorter, longer] = std::minmax(pictureWidth_, pictureHeight_);
    return static_cast<double>(shorter) / longer;
}

void WaterHost::handOver(const Pictures& pictures, unsigned which) {
    const auto [shorter, longer] = std::minmax(pictureWidth_, pictureHeight_);
    if (which & Pictures::kPortrait) {
        handOverOne(NATIVE(transferPortraitBGBitmap), cropToAspect(pictures.portrait, shorter, longer));
    }
    if (which & Pictures::kLandscape) {
        handOverOne(NATIVE(transferLandscapeBGBitmap), cropToAspect(pictures.landscape, longer, shorter));
    }
    if (which & Pictures::kWater) handOverOne(NATIVE(transferWaterBitmap), pictures.water);
}

void WaterHost::setUp(bool withInk, unsigned textures) {
    JNIEnv* const env = hostEnvironment();
    NATIVE(onInitSetting)(env, nullptr, width_, height_, withInk);
    NATIVE(onInitGPU)(env, nullptr);
    // The library would keep a stroke that the switch interrupts and go on with it at the next touch.
    if (withInk != withInk_) NATIVE(clearInkValue)(env, nullptr);
    withInk_ = withInk;
    inkFrames_ = 0;
    loadTextures(textures);
    if (!isSetUp_) {
        NATIVE(initWaters)
        (env, nullptr, &positions_, &indices_, look_.meshVertices * look_.meshVertices, look_.meshExtent,
         look_.meshExtent, look_.meshVertices, look_.meshVertices);
    }
    isSetUp_ = true;
    changed_ = true;
}

void WaterHost::loadTextures(unsigned which) {
    JNIEnv* const env = hostEnvironment();
    if (which & Pictures::kPortrait) NATIVE(onLoadPortraitBGTextures)(env, nullptr);
    if (which & Pictures::kLandscape) NATIVE(onLoadLandscapeBGTextures)(env, nullptr);
    if (which & Pictures::kWater) NATIVE(onLoadWaterTextures)(env, nullptr);
    changed_ |= which != 0;
}

void WaterHost::setLook(const Look& look) {
    look_ = look;
    changed_ = true;
}

void WaterHost::touch(TouchAction action, int x, int y, float pressure) {
    if (!isSetUp_) return;
    raiseTouchRipples(action, x, y, look_.touchAmplitude * pressure);
    fingerDown_ = action == TouchAction::down || (action == TouchAction::move && fingerDown_);
    if (!withInk_) return;
    NATIVE(onTouch)(hostEnvironment(), nullptr, x, y, static_cast<jint>(action), pressure);
    inkFrames_ = look_.framesToFade;
}

void WaterHost::raiseTouchRipples(TouchAction action, int x, int y, float amplitude) {
    const float modelX = (static_cast<float>(x) / static_cast<float>(width_) - 0.5f) * visibleWidth_;
    const float modelY = (0.5f - static_cast<float>(y) / static_cast<float>(height_)) * visibleHeight_;
    if (action == TouchAction::down) {
        raiseRipple(modelX, modelY, amplitude);
    } else if (action == TouchAction::move && fingerDown_) {
        const float spacing =
            look_.trailCells * static_cast<float>(look_.meshExtent) / static_cast<float>(look_.meshVertices - 1);
        const float dx = modelX - touchX_;
        const float dy = modelY - touchY_;
        const int ripples = static_cast<int>(std::min(std::sqrt(dx * dx + dy * dy) / spacing, look_.longestTrail));
        if (ripples < 1) return;
        for (int i = 1; i <= ripples; ++i) {
            const float t = static_cast<float>(i) / static_cast<float>(ripples);
            raiseRipple(touchX_ + dx * t, touchY_ + dy * t, amplitude * look_.trailShare);
        }
    }
    touchX_ = modelX;
    touchY_ = modelY;
}

void WaterHost::clearInk() {
    if (!isSetUp_) return;
    NATIVE(clearInkValue)(hostEnvironment(), nullptr);
    changed_ = true;
}

bool WaterHost::advance(double seconds) {
    if (!isSetUp_) return false;
    dueSteps_ += std::min(seconds, double{look_.longestFrame}) * look_.stepsPerSecond;
    // The small extra lets a frame of exactly one step's length bring its step in spite of rounding.
    for (; dueSteps_ > 1.0 - 1.0e-6; dueSteps_ -= 1.0) {
        if (raining_) dropRain();
        if (calmSteps_ < look_.stepsToRest) stepWater();
    }
    return changed_ || inkMoves();
}

bool WaterHost::isResting() const {
    return !changed_ && !raining_ && calmSteps_ >= look_.stepsToRest && !inkMoves();
}

void WaterHost::stepWater() {
    const int n = look_.meshVertices;
    const bool calm = NATIVE(move)(
        hostEnvironment(), nullptr, &velocity_, &heights_, 1, 1, n - 1, n - 1, n, n, JNI_TRUE, look_.damping,
        look_.waveSpeed);
    calmSteps_ = calm ? calmSteps_ + 1 : 0;
    changed_ = true;
}

void WaterHost::dropRain() {
    const auto draw = [this] {
        return static_cast<float>(static_cast<double>(random_() - random_.min()) / (random_.max() - random_.min()));
    };
    if (draw() * static_cast<float>(look_.stepsPerSecond) >= look_.rainDropsPerSecond) return;
    const float x = (draw() - 0.5f) * visibleWidth_;
    const float y = (draw() - 0.5f) * visibleHeight_;
    raiseRipple(x, y, look_.rainAmplitude * (0.5f + 0.5f * draw()));
}

void WaterHost::raiseRipple(float x, float y, float amplitude) {
    // The library counts countA cells across the extent, the mesh has one interval less; these positions hit the
    // very vertex. The fast axis runs down a column of the mesh.
    const auto extent = static_cast<float>(look_.meshExtent);
    const auto n = static_cast<float>(look_.meshVertices);
    const float row = (0.5f - y / extent) * (n - 1.0f);
    const float column = (0.5f + x / extent) * (n - 1.0f);
    NATIVE(ripple)
    (hostEnvironment(), nullptr, &heights_, look_.meshExtent, look_.meshExtent, look_.meshVertices, look_.meshVertices,
     (row / n - 0.5f) * extent, (column / n - 0.5f) * extent, amplitude);
    calmSteps_ = 0;
}

// Each vertex gets its own height and those of its right-hand and upper neighbours; vertices are stored column by
// column from the left, each column from the top. The last ones of their kind repeat their own height.
void WaterHost::gatherHeights() {
    const int n = look_.meshVertices;
    const float* const h = heights_.values.data();
    float* attribs = heightAttribs_.values.data();
    for (int column = 0, i = 0; column < n; ++column) {
        for (int row = 0; row < n; ++row, ++i) {
            *attribs++ = h[i];
            *attribs++ = column < n - 1 ? h[i + n] : h[i];
            *attribs++ = row > 0 ? h[i - 1] : h[i];
        }
    }
}

void WaterHost::draw() {
    gatherHeights();
    NATIVE(onDrawFrame)
    (hostEnvironment(), nullptr, &positions_, &heightAttribs_, &indices_, static_cast<jint>(positions_.values.size()),
     static_cast<jint>(heightAttribs_.values.size()), static_cast<jint>(indices_.values.size()), &mvp_, pictureWidth_,
     pictureHeight_, look_.meshVertices, look_.meshVertices, look_.refractiveIndex, look_.alphaMix, look_.alphaScale1,
     look_.alphaScale2, look_.inkRed, look_.inkGreen, look_.inkBlue, look_.fresnelRatio, look_.specularRatio,
     look_.exponent, width_ > height_);
    changed_ = false;
    if (inkFrames_ > 0) --inkFrames_;
}
