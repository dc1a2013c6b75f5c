// Runs the host one frame at a time, with any implementation of GL.
#pragma once

#include <android/log.h>

#include <cmath>

#include "host/water_host.h"
#include "probes/gesture_state.h"
#include "probes/smooth_picture.h"

namespace tidemark {

enum class Scene { water, idleInk, drag };

class FrameScene {
public:
    // Draws `warmUp` frames, so that no later frame allocates or initializes anything.
    FrameScene(Scene scene, int vertices, int width, int height, int warmUp)
        : scene_(scene), width_(width), height_(height), host_(lookWith(vertices), width, height, 1) {
        __android_log_set_logger([](const __android_log_message*) {});
        resetGestures();
        const Pictures pictures = {smoothPicture(64, 64, 1), smoothPicture(64, 64, 2), smoothPicture(64, 64, 3)};
        host_.setUp(scene != Scene::water);
        host_.loadPictures(sourceOf(pictures));
        host_.rain(true);
        touch(TouchAction::down);
        if (scene == Scene::idleInk) touch(TouchAction::up);
        for (int i = 0; i < warmUp; ++i) next();
    }

    void next() {
        ++frame_;
        if (scene_ == Scene::drag) touch(TouchAction::move);
        host_.advance(1.0 / 60.0);
        host_.draw();
    }

    const WaterHost& host() const { return host_; }

private:
    static Look lookWith(int vertices) {
        Look look;
        look.meshVertices = vertices;
        return look;
    }

    // Moves on a circle around the centre of the view, fast enough for a fast drag.
    void touch(TouchAction action) {
        const float angle = 0.15f * static_cast<float>(frame_);
        const float radius = 0.3f * static_cast<float>(width_);
        host_.touch(
            action, width_ / 2 + static_cast<int>(radius * std::cos(angle)),
            height_ / 2 + static_cast<int>(radius * std::sin(angle)), 1.0f);
    }

    Scene scene_;
    int width_;
    int height_;
    int frame_ = 0;
    WaterHost host_;
};

inline const char* nameOf(Scene scene) {
    return scene == Scene::water ? "water" : scene == Scene::idleInk ? "idle ink" : "fast drag";
}

}  // namespace tidemark
