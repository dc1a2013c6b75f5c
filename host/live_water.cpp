#include "host/live_water.h"

#include <utility>

LiveWater::LiveWater(const Look& look, std::uint32_t seed) : look_(look), seed_(seed), host_(look, 1, 1, seed) {}

void LiveWater::setPictures(Pictures pictures) {
    pictures_ = std::move(pictures);
    picturesDue_ = true;
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

void LiveWater::prepare() {
    if (setUpDue_ || picturesDue_) host_.handOver(pictures_.portrait, pictures_.landscape, pictures_.water);
    if (setUpDue_) {
        host_.setUp(withInk_);
    } else if (picturesDue_) {
        host_.showPictures();
    }
    setUpDue_ = picturesDue_ = false;
}

LiveWater::Frame LiveWater::frame(double now) {
    if (pictures_.water.rgba.empty()) return Frame::resting;
    prepare();
    if (host_.isResting()) {
        clock_.rest();
        return Frame::resting;
    }
    if (clock_.isEarly(now, look_.stepsPerSecond)) return Frame::waiting;
    if (!host_.advance(clock_.secondsUntil(now, look_.stepsPerSecond))) return Frame::waiting;
    host_.draw();
    return Frame::drawn;
}
