#include "host/live_water.h"

LiveWater::LiveWater(const Look& look, std::uint32_t seed) : host_(look, 1, 1, seed) {}

void LiveWater::setPictures(Pictures pictures) {
    handOverDue_ |= pictures.newSince(pictures_);
    pictures_ = std::move(pictures);
}

void LiveWater::resize(int width, int height) {
    host_.resize(width, height);
    clock_.rest();
    setUpDue_ = true;
}

void LiveWater::setInk(bool withInk) {
    if (withInk == withInk_) return;
    withInk_ = withInk;
    setUpDue_ = true;
}

void LiveWater::renewContext() {
    setUpDue_ = true;
    texturesDue_ = Pictures::kAll;
}

void LiveWater::prepare() {
    if (host_.proportions() != proportions_) handOverDue_ |= Pictures::kBackgrounds;
    proportions_ = host_.proportions();
    host_.handOver(pictures_, handOverDue_);
    const unsigned textures = handOverDue_ | texturesDue_;
    prepared_ |= setUpDue_ || textures;
    if (setUpDue_) {
        host_.setUp(withInk_, textures);
    } else {
        host_.loadTextures(textures);
    }
    setUpDue_ = false;
    handOverDue_ = texturesDue_ = 0;
}

bool LiveWater::isResting() const {
    if (pictures_.light.rgba.empty()) return true;
    return !setUpDue_ && !handOverDue_ && host_.isResting();
}

LiveWater::Frame LiveWater::frame(double now) {
    if (isResting()) {
        clock_.rest();
        return Frame::resting;
    }
    prepare();
    if (!host_.advance(clock_.secondsUntil(now))) return Frame::waiting;
    host_.draw();
    if (isResting()) clock_.rest();
    return Frame::drawn;
}
