#include "host/live_water.h"

#include <algorithm>
#include <cmath>
#include <ctime>
#include <limits>
#include <utility>

#include "host/look_values.h"

namespace tidemark {

namespace {

// A new size is applied after this many seconds without a change.
constexpr double kSettleSeconds = 0.1;

// Pictures are transferred again if the view has grown by more than this factor.
constexpr double kGrowth = 1.25;

// Limit of splashes before a frame.
constexpr std::size_t kMostSplashes = 64;

// The ink steps that make up for a late frame may take this share of the time since the previous frame.
constexpr double kInkShare = 0.25;

}  // namespace

double steadySeconds() {
    timespec now = {};
    clock_gettime(CLOCK_MONOTONIC, &now);
    return static_cast<double>(now.tv_sec) + 1e-9 * static_cast<double>(now.tv_nsec);
}

float penWeight(float pressure) {
    constexpr float kOrdinary = 0.5f;  // pressure of an ordinary stroke
    const float weight = pressure / kOrdinary;
    return weight > 0.3f ? std::min(weight, 1.5f) : 0.3f;
}

LiveWater::LiveWater(PictureSource pictures, std::uint32_t seed, Clock clock)
    : host_(Look{}, 1, 1, seed), pictures_(std::move(pictures)), clock_(clock) {
    pace_.allowResolution(true);
}

void LiveWater::setView(double width, double height, double density, double now) {
    const ViewSize view = {width, height, density};
    if (!(width > 0.0 && height > 0.0 && density > 0.0) || view == view_) return;
    view_ = view;
    // The time of the first frame may be that of a refresh before this call.
    settledAt_ = surface_.width == 0 ? std::numeric_limits<double>::lowest() : now + kSettleSeconds;
    fitSurface();
}

void LiveWater::setQuality(Quality quality) {
    if (quality == quality_) return;
    quality_ = quality;
    pace_.allowResolution(quality == Quality::automatic);
    fitSurface();
}

void LiveWater::fitSurface() {
    wanted_ = drawnSize(view_, quality_, pace_.level().resolution);
}

void LiveWater::resized() {
    if (wanted_ == surface_) return host_.redraw();
    surface_ = wanted_;
    host_.resize(surface_.width, surface_.height);
    setUpDue_ = true;
    pace_.interrupt();
}

const LookField* LiveWater::setLook(const Look& look) {
    const LookField* const invalid = firstInvalid(look);
    if (invalid) return invalid;
    const auto changesShade = [&](PictureSlot slot) {
        return shadeOf(host_.look(), slot, 1.0f) != shadeOf(look, slot, 1.0f);
    };
    if (changesShade(PictureSlot::portrait)) pictureDue_ |= known_ & kBackgrounds;
    if (changesShade(PictureSlot::light)) pictureDue_ |= known_ & kLightPicture;
    host_.setLook(look);
    longestFrame_ = double{look.longestFrame};
    return nullptr;
}

void LiveWater::setInk(bool withInk) {
    setUpDue_ |= withInk != withInk_;
    withInk_ = withInk;
}

void LiveWater::touch(TouchAction action, float x, float y, float weight, double time) {
    if (known_ != kAllPictures) return;
    touches_.push_back({action, x, y, weight, time});
}

void LiveWater::splash(float x, float y, float weight, bool withInk) {
    if (splashes_.size() < kMostSplashes) splashes_.push_back({x, y, weight, withInk});
}

void LiveWater::picturesChanged(unsigned which) {
    pictureDue_ |= which;
    known_ |= which;
}

void LiveWater::renewContext() {
    setUpDue_ = true;
    texturesDue_ = kAllPictures;
}

// Returns whether a frame can be drawn.
bool LiveWater::prepare() {
    if (std::exchange(setUpDue_, false)) {
        host_.setUp(withInk_);
        pace_.interrupt();  // but not for a picture, because a moving one is loaded with every frame
    }
    if (known_ != kAllPictures) return false;
    const int longer = std::max(surface_.width, surface_.height);
    if (host_.proportions() != proportions_ || longer > kGrowth * longest_) {
        pictureDue_ |= kBackgrounds;
        proportions_ = host_.proportions();
        longest_ = longer;
    }
    const unsigned textures = pictureDue_ | texturesDue_;
    if (textures) host_.loadPictures(pictures_, std::exchange(pictureDue_, 0), std::exchange(texturesDue_, 0));
    return true;
}

bool LiveWater::isResting() const {
    return !isSurfaceDue() && (surface_.width == 0 || isStill());
}

bool LiveWater::isChangeDue() const {
    return setUpDue_ || (known_ == kAllPictures && (pictureDue_ || !touches_.empty() || !splashes_.empty()));
}

bool LiveWater::isStill() const {
    return !isChangeDue() && (known_ != kAllPictures || host_.isResting());
}

bool LiveWater::isSurfaceDue() const {
    return view_.width != 0.0 && wanted_ != surface_ && wanted_ != asked_;
}

// After a rest, one ordinary frame passes.
double LiveWater::secondsUntil(double now) {
    const double seconds = isRunning_ ? now - now_ : 1.0 / 60;
    if (!isRunning_) pace_.interrupt();
    isRunning_ = true;
    now_ = now;
    return std::max(seconds, 0.0);
}

void LiveWater::draw(double seconds) {
    const double end = clock_() + kInkShare * seconds;
    host_.draw([this, end, left = pace_.level().inkSteps]() mutable { return --left <= 0 || clock_() > end; });
}

LiveWater::Frame LiveWater::frame(double now) {
    if (isResting()) {
        isRunning_ = false;
        return Frame::resting;
    }
    if (isSurfaceDue() && now >= settledAt_) {
        asked_ = wanted_;
        return Frame::resize;
    }
    if (surface_.width == 0 || !prepare()) return Frame::waiting;
    const double seconds = std::min(secondsUntil(now), longestFrame_);
    for (const Splash& splash : splashes_) {
        const double x = double{splash.x} * surface_.width;
        const double y = double{splash.y} * surface_.height;
        if (splash.withInk && !host_.isTouched()) {
            for (const TouchAction action : {TouchAction::down, TouchAction::up}) {
                host_.touch(action, x, y, splash.weight, host_.time() + seconds);
            }
        } else {
            host_.splash(x, y, splash.weight);
        }
    }
    splashes_.clear();
    for (const Touch& touch : touches_) {
        // On the host's clock, which stops while the water rests.
        const double ago = std::clamp(now - touch.time, -0.1, 1.0);
        host_.touch(
            touch.action, double{touch.x} * surface_.width, double{touch.y} * surface_.height, touch.weight,
            host_.time() + seconds - ago);
    }
    touches_.clear();
    if (!host_.advance(seconds)) {
        // A touch may change nothing, for example a stroke's end without ink.
        isRunning_ = !isResting();
        return isRunning_ ? Frame::waiting : Frame::resting;
    }
    draw(seconds);
    // A change of the resolution loses the ink.
    const bool hasInk = host_.inkMoves();
    // Frames of still water take no time and have no pace.
    if (seconds > 0.0 && pace_.frameDrawn(now, shortestFrame_, hasInk)) {
        host_.setMeshShare(pace_.level().mesh);
        fitSurface();
    }
    if (isResting()) isRunning_ = false;
    return Frame::drawn;
}

double LiveWater::due() const {
    constexpr double kNever = std::numeric_limits<double>::infinity();
    const double surface = isSurfaceDue() ? settledAt_ : kNever;
    if (surface_.width == 0 || isStill()) return surface;
    return std::min(surface, now_ + (isChangeDue() ? 0.0 : host_.due() - host_.time()));
}

}  // namespace tidemark
