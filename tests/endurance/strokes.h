#pragma once

#include <cmath>
#include <cstdlib>
#include <random>
#include <string_view>
#include <vector>

#include "host/picture.h"
#include "host/water_host.h"
#include "probes/smooth_picture.h"

inline bool isFullLength() {
    const char* const length = std::getenv("TIDEMARK_ENDURANCE");
    return length && std::string_view(length) == "full";
}

struct StrokeEvent {
    tidemark::TouchAction action;
    double x, y;  // fractions of the view; some are outside 0 to 1
};
using Stroke = std::vector<StrokeEvent>;

// Returns taps and curves of each speed class on a view of about 240 pixels. Some end with a cancel.
inline std::vector<Stroke> strokesOfAllKinds() {
    std::mt19937 random(1);
    std::normal_distribution<double> place(0.5, 0.15);
    std::uniform_real_distribution<double> turn(-0.3, 0.3), share(0.2, 1.8);
    std::vector<Stroke> strokes;
    for (int i = 0; i < 16; ++i) {
        const double length = std::vector{0.0, 0.009, 0.025, 0.08}[static_cast<std::size_t>(i % 4)];  // of a move
        Stroke stroke = {{tidemark::TouchAction::down, place(random), place(random)}};
        double direction = 20 * turn(random);
        for (auto moves = 8 + random() % 32; moves > 0; --moves) {
            direction += turn(random);
            const auto [action, x, y] = stroke.back();
            const double way = length * share(random);
            stroke.push_back(
                {tidemark::TouchAction::move, x + way * std::cos(direction), y + way * std::sin(direction)});
        }
        stroke.push_back(stroke.back());
        stroke.back().action = i % 5 == 4 ? tidemark::TouchAction::cancel : tidemark::TouchAction::up;
        strokes.push_back(stroke);
    }
    return strokes;
}

// Sets up the library and loads its pictures. `due` selects the pictures to transfer first.
inline void setUp(tidemark::WaterHost& host, bool withInk, unsigned due = 0) {
    static const tidemark::Pictures pictures = {
        smoothPicture(24, 32, 1), smoothPicture(32, 24, 2), smoothPicture(8, 8, 3)};
    static const tidemark::PictureSource source = tidemark::sourceOf(pictures);
    host.setUp(withInk);
    host.loadPictures(source, due);
}
