#include "host/water_host.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "host/look_limits.h"
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

constexpr double kInkStepsPerSecond = 60.0;
constexpr int kMostInkSteps = 4;

// Nearer to a step than this, in steps, the heights are those of the step.
constexpr float kAtStep = 0.0625f;

// The peak of a ripple is three times as high, and the water keeps heights of up to 100.
constexpr float kMostAmplitude = 100.0f / 3.0f;

// Steps are taken at the time nearest to theirs, so that neither the jitter of a clock nor rounding brings none to one
// frame and two to the next.
int takeSteps(double& due) {
    const int steps = std::max(static_cast<int>(std::floor(due + 0.5)), 0);
    due -= steps;
    return steps;
}

// A field on a lattice of another size, by its nearest values.
std::vector<float> resampled(const std::vector<float>& field, int from, int to) {
    std::vector<float> result(static_cast<std::size_t>(to) * static_cast<std::size_t>(to));
    const auto nearest = [=](int i) { return (2 * i * (from - 1) + to - 1) / (2 * (to - 1)); };
    for (int c = 0; c < to && from > 1; ++c) {
        for (int r = 0; r < to; ++r) {
            result[static_cast<std::size_t>(c * to + r)] =
                field[static_cast<std::size_t>(nearest(c) * from + nearest(r))];
        }
    }
    return result;
}

}  // namespace

WaterHost::WaterHost(const Look& look, int width, int height, std::uint32_t seed)
    : look_(withinLimits(look)), random_(seed), calmSteps_(look_.stepsToRest), lattice_{} {
    resize(width, height);
}

void WaterHost::resize(int width, int height) {
    width_ = width;
    height_ = height;
    quality_.fitTo(width, height, look_.pictureZoom);
    fit();
}

void WaterHost::setLook(const Look& look) {
    look_ = withinLimits(look);
    fit();
}

void WaterHost::noteWork(double seconds) {
    quality_.noteWork(seconds);
    if (wantedVertices() != vertices_) fit();
}

// Lays the lattice and the mesh, squares around the view, so that their cells are squares on the screen and rings stay
// round. The view shows the middle of them.
void WaterHost::fit() {
    const WaveLattice old = lattice_;
    lattice_ = latticeFor(look_, width_, height_);
    if (lattice_.points != old.points) {
        velocity_.values = resampled(velocity_.values, old.points, lattice_.points);
        heights_.values = resampled(heights_.values, old.points, lattice_.points);
    }
    const float pixel =
        static_cast<float>(lattice_.extent) / look_.pictureZoom / static_cast<float>(std::max(width_, height_));
    const float oldWidth = std::exchange(visibleWidth_, pixel * static_cast<float>(width_));
    const float oldHeight = std::exchange(visibleHeight_, pixel * static_cast<float>(height_));
    const int vertices = wantedVertices();
    if (lattice_.points != old.points || lattice_.extent != old.extent || vertices != vertices_ ||
        visibleWidth_ != oldWidth || visibleHeight_ != oldHeight) {
        makeMesh(vertices);
    }
    pictureWidth_ = static_cast<int>(std::ceil(visibleWidth_));
    pictureHeight_ = static_cast<int>(std::ceil(visibleHeight_));
    mvp_.values = {2.0f / visibleWidth_, 0, 0, 0, 0, 2.0f / visibleHeight_, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
    changed_ = true;
}

void WaterHost::makeMesh(int vertices) {
    vertices_ = vertices;
    mesh_ = SurfaceMesh(
        lattice_.points, vertices, double{visibleWidth_} / lattice_.extent, double{visibleHeight_} / lattice_.extent);
    isGathered_ = false;
    isMeshFilled_ = false;
}

// Takes from the library's square what the view shows, with cells whose diagonals can be turned.
void WaterHost::fillMesh() {
    const auto side = static_cast<std::size_t>(vertices_);
    FloatArray positions(3 * side * side);
    ShortArray indices(6 * (side - 1) * (side - 1));
    native::initWaters(
        hostEnvironment(), nullptr, &positions, &indices, vertices_ * vertices_, lattice_.extent, lattice_.extent,
        vertices_, vertices_);
    const auto [firstColumn, columns] = mesh_.columns();
    const auto [firstRow, rows] = mesh_.rows();
    const int vertices = columns * rows;
    positions_ = FloatArray(3 * static_cast<std::size_t>(vertices));
    heightAttribs_ = FloatArray(positions_.values.size());
    for (int c = 0; c < columns; ++c) {
        std::copy_n(
            positions.values.begin() + 3 * ((firstColumn + c) * vertices_ + firstRow), 3 * rows,
            positions_.values.begin() + 3 * c * rows);
    }
    indices_ = ShortArray(6 * static_cast<std::size_t>((columns - 1) * (rows - 1)));
    mesh_.layCells(indices_.values.data());
    isMeshFilled_ = true;
}

double WaterHost::proportions() const {
    const auto [shorter, longer] = std::minmax(pictureWidth_, pictureHeight_);
    return static_cast<double>(shorter) / longer;
}

void WaterHost::handOver(const Pictures& pictures, unsigned which) {
    const auto [shorter, longer] = std::minmax(pictureWidth_, pictureHeight_);
    if (which & Pictures::kPortrait) {
        handOverOne(native::transferPortraitBGBitmap, cropToAspect(pictures.portrait, shorter, longer));
    }
    if (which & Pictures::kLandscape) {
        handOverOne(native::transferLandscapeBGBitmap, cropToAspect(pictures.landscape, longer, shorter));
    }
    if (which & Pictures::kLight) handOverOne(native::transferWaterBitmap, pictures.light);
}

void WaterHost::setUp(bool withInk, unsigned textures) {
    JNIEnv* const env = hostEnvironment();
    native::onInitSetting(env, nullptr, width_, height_, withInk);
    native::onInitGPU(env, nullptr);
    // The library would keep a stroke that the switch interrupts and go on with it at the next touch.
    if (withInk != withInk_) native::clearInkValue(env, nullptr);
    withInk_ = withInk;
    inkSteps_ = 0;
    loadTextures(textures);
    isSetUp_ = true;
    changed_ = true;
}

void WaterHost::loadTextures(unsigned which) {
    JNIEnv* const env = hostEnvironment();
    if (which & Pictures::kPortrait) native::onLoadPortraitBGTextures(env, nullptr);
    if (which & Pictures::kLandscape) native::onLoadLandscapeBGTextures(env, nullptr);
    if (which & Pictures::kLight) native::onLoadWaterTextures(env, nullptr);
    changed_ |= which != 0;
}

void WaterHost::touch(TouchAction action, int x, int y, float pressure) {
    if (!isSetUp_) return;
    if (!inkMoves()) dueInkSteps_ = 0.0;
    raiseTouchRipples(action, x, y, look_.touchAmplitude * pressure);
    fingerDown_ = action == TouchAction::down || (action == TouchAction::move && fingerDown_);
    if (!withInk_) return;
    native::onTouch(hostEnvironment(), nullptr, x, y, static_cast<jint>(action), pressure);
    inkSteps_ = look_.framesToFade;
}

void WaterHost::raiseTouchRipples(TouchAction action, int x, int y, float amplitude) {
    const float modelX = (static_cast<float>(x) / static_cast<float>(width_) - 0.5f) * visibleWidth_;
    const float modelY = (0.5f - static_cast<float>(y) / static_cast<float>(height_)) * visibleHeight_;
    if (action == TouchAction::down) {
        raiseRipple(modelX, modelY, amplitude);
    } else if (action == TouchAction::move && fingerDown_) {
        const float spacing =
            look_.trailCells * static_cast<float>(lattice_.extent) / static_cast<float>(lattice_.points - 1);
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

void WaterHost::splash(int x, int y, float pressure) {
    if (!isSetUp_) return;
    const float modelX = (static_cast<float>(x) / static_cast<float>(width_) - 0.5f) * visibleWidth_;
    const float modelY = (0.5f - static_cast<float>(y) / static_cast<float>(height_)) * visibleHeight_;
    raiseRipple(modelX, modelY, look_.touchAmplitude * pressure);
}

void WaterHost::clearInk() {
    if (!isSetUp_) return;
    native::clearInkValue(hostEnvironment(), nullptr);
    changed_ = true;
}

bool WaterHost::advance(double seconds) {
    if (!isSetUp_) return false;
    const double passed = std::min(seconds, double{look_.longestFrame});
    dueSteps_ += passed * lattice_.stepsPerSecond;
    for (int steps = takeSteps(dueSteps_); steps > 0; --steps) {
        if (raining_) dropRain();
        if (calmSteps_ < look_.stepsToRest) stepWater();
    }
    if (calmSteps_ < look_.stepsToRest) changed_ = true;
    if (!inkMoves()) return changed_;
    dueInkSteps_ += passed * kInkStepsPerSecond;
    return dueInkSteps_ >= 0.5;
}

bool WaterHost::isResting() const {
    return !changed_ && !raining_ && calmSteps_ >= look_.stepsToRest && !inkMoves();
}

void WaterHost::stepWater() {
    const int n = lattice_.points;
    const bool calm = native::move(
        hostEnvironment(), nullptr, &velocity_, &heights_, 1, 1, n - 1, n - 1, n, n, JNI_TRUE, lattice_.damping,
        lattice_.waveSpeed);
    calmSteps_ = calm ? calmSteps_ + 1 : 0;
    isGathered_ = false;
    changed_ = true;
}

void WaterHost::dropRain() {
    const auto draw = [this] {
        return static_cast<float>(static_cast<double>(random_() - random_.min()) / (random_.max() - random_.min()));
    };
    if (draw() * static_cast<float>(lattice_.stepsPerSecond) >= look_.rainDropsPerSecond) return;
    const float x = (draw() - 0.5f) * visibleWidth_;
    const float y = (draw() - 0.5f) * visibleHeight_;
    raiseRipple(x, y, look_.rainAmplitude * (0.5f + 0.5f * draw()));
}

void WaterHost::raiseRipple(float x, float y, float amplitude) {
    if (!std::isfinite(amplitude)) return;
    // The library counts countA cells across the extent, the lattice has one interval less; these positions hit the
    // very point. The fast axis runs down a column of the lattice.
    const auto extent = static_cast<float>(lattice_.extent);
    const auto n = static_cast<float>(lattice_.points);
    const float row = (0.5f - y / extent) * (n - 1.0f);
    const float column = (0.5f + x / extent) * (n - 1.0f);
    native::ripple(
        hostEnvironment(), nullptr, &heights_, lattice_.extent, lattice_.extent, lattice_.points, lattice_.points,
        (row / n - 0.5f) * extent, (column / n - 0.5f) * extent,
        std::clamp(amplitude, -kMostAmplitude, kMostAmplitude));
    calmSteps_ = 0;
    isGathered_ = false;
}

// The heights at the time of the frame, which on a display faster than the water lies between two steps.
void WaterHost::gatherHeights() {
    const bool moves = calmSteps_ < look_.stepsToRest;
    const auto since = static_cast<float>(dueSteps_);
    const bool atStep = !moves || std::abs(since) < kAtStep;
    if (atStep && isGathered_) return;
    mesh_.gather(
        heights_.values.data(), velocity_.values.data(), atStep ? 0.0f : since, heightAttribs_.values.data(),
        indices_.values.data());
    isGathered_ = atStep;
}

void WaterHost::draw() {
    JNIEnv* const env = hostEnvironment();
    if (!isMeshFilled_) fillMesh();
    gatherHeights();
    int frames = 1;
    if (inkMoves()) {
        frames = std::clamp(takeSteps(dueInkSteps_), 1, kMostInkSteps);
        dueInkSteps_ = std::clamp(dueInkSteps_, -0.5, 0.5);
    }
    for (int i = 1; i <= frames; ++i) {
        // Only the last one is seen. The others move the ink below a mesh of nothing.
        const auto sizeOf = [&](const auto& array) { return i == frames ? static_cast<jint>(array.values.size()) : 0; };
        native::onDrawFrame(
            env, nullptr, &positions_, &heightAttribs_, &indices_, sizeOf(positions_), sizeOf(heightAttribs_),
            sizeOf(indices_), &mvp_, pictureWidth_, pictureHeight_, vertices_, vertices_, look_.refractiveIndex,
            look_.alphaMix, look_.alphaScale1, look_.alphaScale2, look_.inkRed, look_.inkGreen, look_.inkBlue,
            look_.fresnelRatio, look_.specularRatio, look_.exponent, width_ > height_);
        if (inkSteps_ > 0) --inkSteps_;
    }
    changed_ = false;
}
