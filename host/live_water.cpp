#include "host/live_water.h"

#include <utility>

LiveWater::LiveWater(const Look& look, std::uint32_t seed) : look_(look), seed_(seed), host_(look, 1, 1, seed) {}

void LiveWater::setPictures(Pictures pictures) {
    handOverDue_ |= pictures.newSince(pictures_);
    pictures_ = std::move(pictures);
}

void LiveWater::resize(int width, int height) {
    width_ = width;
    height_ = height;
    host_.resize(width, height);
    clock_.rest();
    setUpDue_ = true;
}

void LiveWater::setLook(const Look& look) {
    const bool sameMesh = look.meshVertices == look_.meshVertices && look.meshExtent == look_.meshExtent &&
                          look.pictureZoom == look_.pictureZoom;
    look_ = look;
    if (sameMesh) {
        host_.setLook(look);
        return;
    }
    host_.clearInk();
    host_ = WaterHost(look, width_, height_, seed_);
    host_.rain(raining_);
    setUpDue_ = true;
}

void LiveWater::setInk(bool withInk) {
    if (withInk == withInk_) return;
    withInk_ = withInk;
    setUpDue_ = true;
}

void LiveWater::setRain(bool falling) {
    raining_ = falling;
    host_.rain(falling);
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
    if (setUpDue_) {
        host_.setUp(withInk_, textures);
    } else {
        host_.loadTextures(textures);
    }
    setUpDue_ = false;
    handOverDue_ = texturesDue_ = 0;
}

bool LiveWater::isResting() const {
    if (pictures_.water.rgba.empty()) return true;
    return !setUpDue_ && !handOverDue_ && host_.isResting();
}

LiveWater::Frame LiveWater::frame(double now) {
    if (isResting()) {
        clock_.rest();
        return Frame::resting;
    }
    prepare();
    if (clock_.isEarly(now, look_.stepsPerSecond)) return Frame::waiting;
    if (!host_.advance(clock_.secondsUntil(now, look_.stepsPerSecond))) return Frame::waiting;
    host_.draw();
    if (isResting()) clock_.rest();
    return Frame::drawn;
}
