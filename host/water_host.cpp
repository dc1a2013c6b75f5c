#include "host/water_host.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "host/native_names.h"

namespace tidemark {

namespace {

constexpr int kMostInkSteps = 4;

// Delay of the ink behind the finger, in seconds: 1.25 report intervals of a 60 Hz digitizer, so that each step lies
// between two reports.
constexpr double kInkDelay = 1.25 / 60;

// A stroke's first step may come earlier by this time, so that a frame that nearly reaches it does not leave two steps
// for the next frame.
constexpr double kEarly = 0.3 / 60;

// A drop is raised in this many wave steps, weighted by the first half period of a sine.
constexpr int kDropSteps = 8;

// The phases of a drop that rebounds: a crest, a crater, and a lower crest.
constexpr int kRebounds = 2;
constexpr double kHalfTurn = 3.141592653589793;

// Limit of simultaneous drops, more than fingers and rain raise.
constexpr std::size_t kMostDrops = 2048;

constexpr float kLightestTouch = 0.3f;
constexpr float kHeaviestTouch = 1.5f;

// Duration of the breeze after the last drop, and of its rise and fall, in seconds.
constexpr double kBreezeSeconds = 4.0;
constexpr double kRisingSeconds = 1.5;
constexpr double kSinkingSeconds = 4.0;

// Within this fraction of a step, the heights are not interpolated.
constexpr float kAtStep = 0.0625f;

// The peak of a ripple is three times its amplitude; heights are limited to 100.
constexpr float kMostAmplitude = 100.0f / 3.0f;

// Cells of the drawn mesh are at most 6 pixels wide; 16-bit indices limit its size.
constexpr double kCellPixels = 6.0;
constexpr double kFewestVertices = 48.0;
constexpr double kMostVertices = 256.0;

// Rounds to the nearest step, so that clock jitter does not give one frame no step and the next frame two.
int takeSteps(double& due) {
    const int steps = std::max(static_cast<int>(std::floor(due + 0.5)), 0);
    due -= steps;
    return steps;
}

// Copies a field to a lattice of another size by nearest-neighbour sampling.
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
    : look_(look), random_(seed), calmSteps_(look_.stepsToRest), breeze_({}), lattice_{} {
    resize(width, height);
}

void WaterHost::resize(int width, int height) {
    width_ = width;
    height_ = height;
    fit();
}

void WaterHost::setLook(const Look& look) {
    look_ = look;
    fit();
}

void WaterHost::setMeshShare(double share) {
    meshShare_ = share;
    if (wantedVertices() != vertices_) fit();
}

int WaterHost::wantedVertices() const {
    if (look_.meshVertices > 1) return look_.meshVertices;
    const double cells = std::ceil(std::max(width_, height_) * double{look_.pictureZoom} / kCellPixels);
    const double most = std::clamp(cells + 1.0, 96.0, kMostVertices);
    return static_cast<int>(std::max(most * meshShare_, kFewestVertices));
}

// Creates the lattice and the mesh as squares around the view. Their cells are then square on the screen and rings are
// round; the view shows their middle.
void WaterHost::fit() {
    const WaveLattice old = lattice_;
    lattice_ = latticeFor(look_, width_, height_);
    if (lattice_.points != old.points) {
        velocity_.values = resampled(velocity_.values, old.points, lattice_.points);
        heights_.values = resampled(heights_.values, old.points, lattice_.points);
    }
    if (lattice_.points != old.points || lattice_.cell != old.cell) breeze_ = Breeze(lattice_);
    const float pixel =
        static_cast<float>(lattice_.extent) / look_.pictureZoom / static_cast<float>(std::max(width_, height_));
    const float oldWidth = std::exchange(visibleWidth_, pixel * static_cast<float>(width_));
    const float oldHeight = std::exchange(visibleHeight_, pixel * static_cast<float>(height_));
    const int vertices = wantedVertices();
    if (lattice_.points != old.points || lattice_.extent != old.extent || vertices != vertices_ ||
        visibleWidth_ != oldWidth || visibleHeight_ != oldHeight) {
        makeMesh(vertices);
    }
    // A flat surface shows the picture smaller than the mesh by the zoom, so the picture must be larger than the
    // visible part.
    const auto extent = [this](float visible) {
        constexpr float kRounding = 1e-3f;
        return std::max(static_cast<int>(std::ceil(visible * look_.pictureZoom - kRounding)), 1);
    };
    pictureWidth_ = extent(visibleWidth_);
    pictureHeight_ = extent(visibleHeight_);
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

// Keeps the visible part of the library's square mesh, with indices whose diagonals can be turned.
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

void WaterHost::loadPictures(const PictureSource& pictures, unsigned due, unsigned which) {
    JNIEnv* const env = hostEnvironment();
    // The number of picture pixels that the view shows.
    const int longer = static_cast<int>(std::ceil(std::max(width_, height_) * double{look_.pictureZoom}));
    const int shorter = std::max(static_cast<int>(std::lround(longer * proportions())), 1);
    const auto load = [&](unsigned picture, PictureSlot slot, int width, int height, auto native) {
        if (due & picture) pictures.handOver(slot, width, height);
        if (!((due | which) & picture)) return;
        native(env, nullptr);
        if (pictures.loaded) pictures.loaded(slot);
        changed_ = true;
    };
    load(kPortraitPicture, PictureSlot::portrait, shorter, longer, native::onLoadPortraitBGTextures);
    load(kLandscapePicture, PictureSlot::landscape, longer, shorter, native::onLoadLandscapeBGTextures);
    load(kLightPicture, PictureSlot::light, 0, 0, native::onLoadWaterTextures);
}

void WaterHost::setUp(bool withInk) {
    JNIEnv* const env = hostEnvironment();
    native::onInitSetting(env, nullptr, width_, height_, withInk);
    native::onInitGPU(env, nullptr);
    // Otherwise the library would keep an interrupted stroke and continue it at the next touch.
    if (withInk != withInk_) {
        native::clearInkValue(env, nullptr);
        strokes_.reset();
        inkStart_ = -1.0;
    }
    withInk_ = withInk;
    inkSteps_ = 0;
    isSetUp_ = true;
    redraw();
}

WaterHost::Place WaterHost::modelPlace(double x, double y) const {
    return {
        static_cast<float>(x / width_ - 0.5) * visibleWidth_, static_cast<float>(0.5 - y / height_) * visibleHeight_};
}

void WaterHost::touch(TouchAction action, double x, double y, float weight, double time) {
    if (!isSetUp_ || !std::isfinite(x) || !std::isfinite(y) || !std::isfinite(time)) return;
    constexpr double kFar = 1.0e6;  // pixels
    x = std::clamp(x, -kFar, kFar);
    y = std::clamp(y, -kFar, kFar);
    weight = weight > kLightestTouch ? std::min(weight, kHeaviestTouch) : kLightestTouch;
    raiseTouchRipples(action, modelPlace(x, y), look_.touchAmplitude * weight);
    fingerDown_ = action == TouchAction::down || (action == TouchAction::move && fingerDown_);
    if (!withInk_) return;
    if (!inkMoves() && inkStart_ < 0.0) inkStart_ = std::max(time + kInkDelay, 0.0);
    strokes_.report({action, static_cast<float>(x), static_cast<float>(y), weight, time});
}

void WaterHost::raiseTouchRipples(TouchAction action, Place place, float amplitude) {
    if (action == TouchAction::down) {
        raise(place, amplitude, look_.rebound);
    } else if (action == TouchAction::move && fingerDown_) {
        const float spacing =
            look_.trailCells * static_cast<float>(lattice_.extent) / static_cast<float>(lattice_.points - 1);
        const float dx = place.x - trail_.x;
        const float dy = place.y - trail_.y;
        const int ripples = static_cast<int>(std::min(std::sqrt(dx * dx + dy * dy) / spacing, look_.longestTrail));
        if (ripples < 1) return;
        for (int i = 1; i <= ripples; ++i) {
            const float t = static_cast<float>(i) / static_cast<float>(ripples);
            raise({trail_.x + dx * t, trail_.y + dy * t}, amplitude * look_.trailShare, 0.0f);
        }
    }
    trail_ = place;
}

void WaterHost::splash(double x, double y, float weight) {
    if (isSetUp_) raise(modelPlace(x, y), look_.touchAmplitude * weight, look_.rebound);
}

void WaterHost::clearInk() {
    if (!isSetUp_) return;
    native::clearInkValue(hostEnvironment(), nullptr);
    changed_ = true;
}

bool WaterHost::advance(double seconds) {
    if (!isSetUp_) return false;
    const double passed = std::min(seconds, double{look_.longestFrame});
    time_ += passed;
    dueSteps_ += passed * lattice_.stepsPerSecond;
    for (int steps = takeSteps(dueSteps_); steps > 0; --steps) {
        if (raining_) dropRain();
        growDrops();
        if (calmSteps_ < look_.stepsToRest) stepWater();
    }
    breathe(passed);
    if (calmSteps_ < look_.stepsToRest) changed_ = true;
    startInk();
    return inkMoves() ? time_ >= due() : changed_;
}

void WaterHost::breathe(double seconds) {
    if (!isBreezy()) return;
    changed_ = true;
    gust_ += isStirred() ? seconds / kRisingSeconds : -seconds / kSinkingSeconds;
    gust_ = std::clamp(gust_, 0.0, 1.0);
}

// Aligns the ink's first step to the first touch, so that strokes do not depend on the frame rate. If that time is
// halfway between two 60 Hz frames, clock jitter could give one frame no step and the next two; then the time is
// shifted slightly.
void WaterHost::startInk() {
    if (inkStart_ < 0.0 || time_ < inkStart_ - kEarly) return;
    const double due = std::min((time_ - inkStart_) / inkStep() + 1.0, double{kMostInkSteps});
    const double share = due - std::floor(due);
    const double calm = share > 0.5 ? std::max(share, 0.65) : std::min(share, 0.35);
    inkTime_ = time_ - (std::floor(due) + calm) * inkStep();
    inkStart_ = -1.0;
}

double WaterHost::due() const {
    if (inkMoves() && !isLost_) return inkTime_ + 0.5 * inkStep();
    return isStill() && inkStart_ >= 0.0 ? inkStart_ - kEarly : time_;
}

bool WaterHost::isResting() const {
    return isStill() && !inkMoves() && inkStart_ < 0.0;
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
    raise({x, y}, look_.rainAmplitude * (0.5f + 0.5f * draw()), look_.rebound);
}

void WaterHost::raise(Place place, float amplitude, float rebound) {
    if (!std::isfinite(amplitude) || !std::isfinite(place.x) || !std::isfinite(place.y)) return;
    if (drops_.size() >= kMostDrops) return;
    calmAt_ = time_ + kBreezeSeconds;
    drops_.push_back({place.x, place.y, std::clamp(amplitude, -kMostAmplitude, kMostAmplitude), rebound, 0});
}

// Advances every drop by one step. The weights of a crest's steps, sin(pi (i + 1/2) / n) sin(pi / 2n), add up to 1; the
// following crater and crest are scaled by the rebound.
void WaterHost::growDrops() {
    if (drops_.empty()) return;
    for (Drop& drop : drops_) {
        const double left = std::pow(double{drop.rebound}, drop.step / kDropSteps);
        const double phase = kHalfTurn * (drop.step++ + 0.5) / kDropSteps;
        addRipple(drop, static_cast<float>(left * std::sin(phase) * std::sin(kHalfTurn / (2 * kDropSteps))));
    }
    std::erase_if(drops_, [](const Drop& drop) {
        return drop.step >= (drop.rebound > 0.0f ? kDropSteps * (1 + kRebounds) : kDropSteps);
    });
    calmSteps_ = 0;
    isGathered_ = false;
}

void WaterHost::addRipple(const Drop& drop, float share) {
    // The library divides the extent into countA cells, the lattice has one interval less. These positions address the
    // exact point. The fast axis runs down a column of the lattice.
    const auto extent = static_cast<float>(lattice_.extent);
    const auto n = static_cast<float>(lattice_.points);
    const float row = (0.5f - drop.y / extent) * (n - 1.0f);
    const float column = (0.5f + drop.x / extent) * (n - 1.0f);
    native::ripple(
        hostEnvironment(), nullptr, &heights_, lattice_.extent, lattice_.extent, lattice_.points, lattice_.points,
        (row / n - 0.5f) * extent, (column / n - 0.5f) * extent, drop.amplitude * share);
}

// Computes the heights at the time of the frame. On a display faster than the wave steps this is between two steps.
void WaterHost::gatherHeights() {
    const bool moves = calmSteps_ < look_.stepsToRest;
    const auto since = static_cast<float>(dueSteps_);
    const bool atStep = !moves || std::abs(since) < kAtStep;
    if (atStep && isGathered_ && !isBreezy()) return;
    const double strength = gust_ * gust_ * (3.0 - 2.0 * gust_);
    breeze_.blow(look_.breeze * static_cast<float>(strength), time_);
    mesh_.gather(
        heights_.values.data(), velocity_.values.data(), atStep ? 0.0f : since, heightAttribs_.values.data(),
        indices_.values.data(), isBreezy() ? &breeze_ : nullptr);
    isGathered_ = atStep && !isBreezy();
}

void WaterHost::draw(const std::function<bool()>& isEnough) {
    if (!isMeshFilled_) fillMesh();
    gatherHeights();
    int steps = 1;
    const bool moves = inkMoves();
    if (moves) {
        const double due = (time_ - inkTime_) / inkStep();
        const double whole = std::floor(due + 0.5);
        steps = static_cast<int>(std::clamp(whole, 1.0, double{kMostInkSteps}));
        // Skipped steps take no time. If a frame comes early, the next steps are not moved to the middle between two
        // frames, where clock jitter could give one frame none and the next two.
        const double behind = due < 0.4 ? -0.25 : due - std::max(whole, 1.0);
        inkTime_ = time_ - (behind + steps) * inkStep();
    }
    for (int i = 1; i <= steps; ++i) {
        if (i < steps && isEnough && isEnough()) {
            inkTime_ += (steps - i) * inkStep();
            i = steps;
        }
        if (moves) {
            inkTime_ += inkStep();
            for (const Touch& touch : strokes_.step(inkTime_ - kInkDelay)) {
                const auto pixel = [](float place) { return static_cast<jint>(std::lround(place)); };
                native::onTouch(
                    hostEnvironment(), nullptr, pixel(touch.x), pixel(touch.y), static_cast<jint>(touch.action),
                    touch.weight);
                inkSteps_ = look_.framesToFade;
            }
        }
        // Only the last step's frame is visible. The earlier steps draw a mesh with no vertices.
        drawOnce(i == steps);
        // While a finger rests, the ink must go on.
        if (inkSteps_ > 0 && !strokes_.isActive()) --inkSteps_;
    }
    changed_ = isLost_ = false;
}

void WaterHost::drawOnce(bool isSeen) {
    const auto sizeOf = [isSeen](const auto& array) { return isSeen ? static_cast<jint>(array.values.size()) : 0; };
    native::onDrawFrame(
        hostEnvironment(), nullptr, &positions_, &heightAttribs_, &indices_, sizeOf(positions_), sizeOf(heightAttribs_),
        sizeOf(indices_), &mvp_, pictureWidth_, pictureHeight_, vertices_, vertices_, look_.refractiveIndex,
        look_.alphaMix, look_.alphaScale1, look_.alphaScale2, look_.inkRed, look_.inkGreen, look_.inkBlue,
        look_.fresnelRatio, look_.specularRatio, look_.exponent, width_ > height_);
}

}  // namespace tidemark
