// A square water surface with seeded waves.
#pragma once

#include <random>
#include <vector>

#include "reference/forms.h"

struct Surface {
    // Heights within +-amplitude; N x N vertices.
    explicit Surface(int vertices, float amplitude = 1.0f) : n(vertices), velocity(size()), height(size()) {
        std::mt19937 random(1);
        std::uniform_real_distribution<float> heights(-amplitude, amplitude);
        for (float& h : height) h = heights(random);
    }
    std::size_t size() const { return static_cast<std::size_t>(n) * static_cast<std::size_t>(n); }
    bool step(const Forms& forms, bool checkCalm) {
        return forms.wave(velocity.data(), height.data(), {1, 1, n - 1, n - 1, n}, checkCalm, 0.985f, 0.32f);
    }
    void ripple(const Forms& forms) { forms.ripple({height.data(), 32, 32, n, n}, 1.3f, -2.7f, 0.5f); }

    int n;
    std::vector<float> velocity, height;
};
