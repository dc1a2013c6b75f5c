#include "bench/kernel_sets_agree.h"

#include <cmath>
#include <cstdio>

#include "reference/ink_grid.h"
#include "reference/surface.h"

namespace {

bool close(float a, float b) {
    return std::fabs(a - b) <= 1e-3f * std::max(1.0f, std::fabs(a));
}

bool close(vec2 a, vec2 b) {
    return close(a.x, b.x) && close(a.y, b.y);
}

bool close(unsigned char a, unsigned char b) {
    return a == b;
}

template <class T>
bool agree(const KernelSet& kernels, const char* what, const std::vector<T>& expected, const std::vector<T>& actual) {
    for (std::size_t i = 0; i < expected.size(); ++i) {
        if (close(expected[i], actual[i])) continue;
        std::fprintf(stderr, "%s: %s differs at %zu\n", kernels.name, what, i);
        return false;
    }
    return true;
}

bool surfaceAgrees(const KernelSet& kernels) {
    Surface expected(50);
    Surface actual(50);
    for (int i = 0; i < 20; ++i) {
        const bool calm = expected.step(kLibrary, true);
        if (actual.step(kernels, true) != calm) return false;
    }
    if (kernels.ripple) {
        expected.ripple(kLibrary);
        actual.ripple(kernels);
    }
    return agree(kernels, "velocity", expected.velocity, actual.velocity) &&
           agree(kernels, "height", expected.height, actual.height);
}

bool inkAgrees(const KernelSet& kernels) {
    InkGrid expected(1000, 700);
    InkGrid actual(1000, 700);
    if (!kernels.advection) {
        expected.advect.run();
        expected.diverge.run();
        actual.divergence = expected.divergence;
        expected.solvePressure(kLibrary);
        actual.solvePressure(kernels);
        return agree(kernels, "pressure", expected.pressureTemp, actual.pressureTemp);
    }
    expected.wholeFrame(kLibrary);
    actual.wholeFrame(kernels);
    // Both pack the same field, because a difference in the last bit may change a byte.
    expected.projected = actual.projected;
    expected.pack(kLibrary);
    return agree(kernels, "advection", expected.advected, actual.advected) &&
           agree(kernels, "divergence", expected.divergence, actual.divergence) &&
           agree(kernels, "pressure", expected.pressureTemp, actual.pressureTemp) &&
           agree(kernels, "forcing", expected.pushed, actual.pushed) &&
           agree(kernels, "packing", expected.bytes, actual.bytes);
}

}  // namespace

bool kernelSetsAgree() {
    for (const KernelSet* kernels : {&kScalar, &kAutoVectorized, &kEigen}) {
        if (!surfaceAgrees(*kernels) || !inkAgrees(*kernels)) return false;
    }
    return true;
}
