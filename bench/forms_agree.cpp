#include "bench/forms_agree.h"

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
bool agree(const Forms& forms, const char* what, const std::vector<T>& expected, const std::vector<T>& actual) {
    for (std::size_t i = 0; i < expected.size(); ++i) {
        if (close(expected[i], actual[i])) continue;
        std::fprintf(stderr, "%s: %s differs at %zu\n", forms.name, what, i);
        return false;
    }
    return true;
}

bool surfaceAgrees(const Forms& forms) {
    Surface expected(50);
    Surface actual(50);
    for (int i = 0; i < 20; ++i) {
        const bool calm = expected.step(kLibrary, true);
        if (actual.step(forms, true) != calm) return false;
    }
    if (forms.ripple) {
        expected.ripple(kLibrary);
        actual.ripple(forms);
    }
    return agree(forms, "velocity", expected.velocity, actual.velocity) &&
           agree(forms, "height", expected.height, actual.height);
}

bool inkAgrees(const Forms& forms) {
    InkGrid expected(1000, 700);
    InkGrid actual(1000, 700);
    if (!forms.advection) {
        expected.advect.run();
        expected.diverge.run();
        actual.divergence = expected.divergence;
        expected.solvePressure(kLibrary);
        actual.solvePressure(forms);
        return agree(forms, "pressure", expected.pressureTemp, actual.pressureTemp);
    }
    expected.wholeFrame(kLibrary);
    actual.wholeFrame(forms);
    // Packed from one field, as a last bit may tip a byte over.
    expected.projected = actual.projected;
    expected.pack(kLibrary);
    return agree(forms, "advection", expected.advected, actual.advected) &&
           agree(forms, "divergence", expected.divergence, actual.divergence) &&
           agree(forms, "pressure", expected.pressureTemp, actual.pressureTemp) &&
           agree(forms, "forcing", expected.pushed, actual.pushed) &&
           agree(forms, "packing", expected.bytes, actual.bytes);
}

}  // namespace

bool formsAgree() {
    for (const Forms* forms : {&kScalar, &kAutoVectorized, &kEigen}) {
        if (!surfaceAgrees(*forms) || !inkAgrees(*forms)) return false;
    }
    return true;
}
