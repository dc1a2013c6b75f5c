#include "host/breeze.h"

#include <cmath>
#include <cstddef>
#include <iterator>

#include "base/groups.h"

namespace tidemark {

namespace {

struct Course {
    double length;     // in view heights
    double direction;  // in radians
};

// No two lengths have a simple ratio, so that the pattern does not repeat.
constexpr Course kCourses[] = {{0.43, 0.35}, {0.29, 1.21}, {0.197, -0.42}, {0.149, 0.83}, {0.103, 1.71}};
constexpr double kTurn = 6.283185307179586;
constexpr double kSlowest =
    0.23;  // frequency of the longest wave in turns per second; shorter waves are faster, as on deep water

constexpr double totalLength() {
    double sum = 0.0;
    for (const Course& course : kCourses) sum += course.length;
    return sum;
}

// Returns a wave's share of the total height. All waves have the same steepness.
constexpr float share(const Course& course) {
    return static_cast<float>(course.length / totalLength());
}

}  // namespace

Breeze::Breeze(const WaveLattice& lattice) : points_(lattice.points) {
    static_assert(std::size(kCourses) == kWaves);
    const auto turn = [&](const Course& course) { return kTurn * lattice.cell / course.length; };
    for (int column = 0; column < points_; ++column) {
        for (const Course& course : kCourses) {
            const double phase = turn(course) * std::cos(course.direction) * column;
            columns_.push_back({std::cos(phase), std::sin(phase)});
        }
    }
    for (const Course& course : kCourses) {
        for (int row = 0; row < points_; ++row) {
            const double phase = turn(course) * std::sin(course.direction) * row;
            cosines_.push_back(static_cast<float>(std::cos(phase)));
            sines_.push_back(static_cast<float>(std::sin(phase)));
        }
    }
}

void Breeze::blow(float height, double time) {
    height_ = height;
    for (int i = 0; i < kWaves; ++i) {
        const double speed = kTurn * kSlowest * std::sqrt(kCourses[0].length / kCourses[i].length);
        now_[i] = {std::cos(speed * time), std::sin(speed * time)};
    }
}

void Breeze::add(int column, int row, int count, float* heights) const {
    float c[kWaves], s[kWaves];
    for (int i = 0; i < kWaves; ++i) {
        const Angle& place = columns_[static_cast<std::size_t>(column * kWaves + i)];
        const Angle& now = now_[i];
        c[i] = height_ * share(kCourses[i]) * static_cast<float>(place.cosine * now.cosine + place.sine * now.sine);
        s[i] = height_ * share(kCourses[i]) * static_cast<float>(place.sine * now.cosine - place.cosine * now.sine);
    }
    const int points = points_;
    const float* const cosines = cosines_.data() + row;
    const float* const sines = sines_.data() + row;
    forGroups(0, count, [=]<class F>(F, int r) {
        F h = load<F>(heights + r);
        for (int i = 0; i < kWaves; ++i) {
            h = h + (c[i] * load<F>(cosines + i * points + r) - s[i] * load<F>(sines + i * points + r));
        }
        store(h, heights + r);
    });
}

}  // namespace tidemark
