#pragma once

#include <random>
#include <vector>

#include "reference/kernel_set.h"

// A square water surface with reproducible random heights.
struct Surface {
    explicit Surface(int vertices, float amplitude = 1.0f) : n(vertices), velocity(size()), height(size()) {
        std::mt19937 random(1);
        std::uniform_real_distribution<float> heights(-amplitude, amplitude);
        for (float& h : height) h = heights(random);
    }
    std::size_t size() const { return static_cast<std::size_t>(n) * static_cast<std::size_t>(n); }
    bool step(const KernelSet& kernels, bool checkCalm) {
        return kernels.wave(velocity.data(), height.data(), {1, 1, n - 1, n - 1, n}, checkCalm, 0.985f, 0.32f);
    }
    void ripple(const KernelSet& kernels) { kernels.ripple({height.data(), 32, 32, n, n}, 1.3f, -2.7f, 0.5f); }

    int n;
    std::vector<float> velocity, height;
};
