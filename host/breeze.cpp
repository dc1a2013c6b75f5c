#include "host/breeze.h"

#include <cmath>
#include <utility>

namespace tidemark {

namespace {

struct Course {
    double length;     // view heights
    double direction;  // radians
};

// No two lengths are in a simple ratio, so that the pattern does not come back.
constexpr Course kCourses[] = {{0.43, 0.35}, {0.29, 1.21}, {0.197, -0.42}, {0.149, 0.83}, {0.103, 1.71}};
constexpr double kTurn = 6.283185307179586;
constexpr double kSlowest = 0.23;  // turns a second of the longest wave; shorter ones are faster, as on deep water

double totalLength() {
    double sum = 0.0;
    for (const Course& course : kCourses) sum += course.length;
    return sum;
}

}  // namespace

// All waves are equally steep.
Breeze::Breeze(const WaveLattice& lattice) {
    for (const auto [length, direction] : kCourses) {
        const double k = kTurn * lattice.cell / length;
        Wave wave = {
            k * std::cos(direction),
            kTurn * kSlowest * std::sqrt(kCourses[0].length / length),
            static_cast<float>(length / totalLength()),
            {},
            {}};
        for (int row = 0; row < lattice.points; ++row) {
            const double phase = k * std::sin(direction) * row;
            wave.cosines.push_back(static_cast<float>(std::cos(phase)));
            wave.sines.push_back(static_cast<float>(std::sin(phase)));
        }
        waves_.push_back(std::move(wave));
    }
}

void Breeze::blow(float height, double time) {
    height_ = height;
    time_ = time;
}

void Breeze::add(int column, int row, int count, float* heights) const {
    for (const Wave& wave : waves_) {
        const double phase = wave.turn * column - wave.speed * time_;
        const float c = height_ * wave.share * static_cast<float>(std::cos(phase));
        const float s = height_ * wave.share * static_cast<float>(std::sin(phase));
        const float* const cosines = wave.cosines.data() + row;
        const float* const sines = wave.sines.data() + row;
        for (int i = 0; i < count; ++i) heights[i] += c * cosines[i] - s * sines[i];
    }
}

}  // namespace tidemark
