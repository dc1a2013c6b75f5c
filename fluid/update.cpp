#include <algorithm>
#include <cstdlib>
#include <utility>

#include "base/flush_denormals.h"
#include "base/groups.h"
#include "base/scratch.h"
#include "fluid/fluid.h"
#include "fluid/ink_tuning.h"
#include "fluid/touch.h"
#include "gl/targets.h"
#include "tshader/velocity_packing.h"

namespace {

Scratch<unsigned char> staging("uploading the ink's velocity");

// Sets BoundaryMargin for this touch and weakens the source of a slow or medium drag near an edge. Returns whether the
// touch is inside the margin. By contract a weakened source stays weak until the next preset.
bool chooseMargin(Fluid& f, const Touch& touch) {
    const auto isTouchInside = [&](int margin) { return isInside(f, touch.x, touch.y, margin); };
    f.BoundaryMargin = kMargin;
    if (f.DragMode == kSlowDrag && !isTouchInside(kMargin)) {
        f.SourceRadius = kSlowEdgeRadius;
        f.SourceStrength = kSlowEdgeStrength;
        f.BoundaryMargin = kSlowMargin;
    } else if (f.DragMode == kMediumDrag && !isTouchInside(kMargin)) {
        f.BoundaryMargin = kMediumMargin;
        if (!isTouchInside(kMediumMargin)) {
            f.SourceRadius = kMediumEdgeRadius;
            f.SourceStrength = kMediumEdgeStrength;
        }
    }
    return isTouchInside(f.BoundaryMargin);
}

// Returns position + a random offset within +-5 pixels, so that the source of a resting finger does not act on the same
// cells in every frame. By contract uses lrand48, which the library does not seed.
float jittered(int position) {
    const float random = static_cast<float>(lrand48()) * 4.656613e-10f;
    return static_cast<float>(
        static_cast<double>(static_cast<float>(position)) + (0.5 - static_cast<double>(random)) * 10.0);
}

// Sets velocities beyond +-1e38 and NaN to 0. A huge touch pressure makes the pressure solve overflow, and advection
// would spread the NaN over the field.
void zeroOverflows(const Texture<vec2>& velocity) {
    constexpr float kFastest = 1.0e38f;
    for (int j = 0; j < velocity.height; ++j) {
        float* const row = reinterpret_cast<float*>(velocity.row(j));
        forGroups(0, 2 * velocity.width, [=](auto lanes, int i) {
            using F = decltype(lanes);
            const F speed = load<F>(row + i);
            const auto isInRange = (speed <= kFastest) & (speed >= -kFastest);
            store(isInRange ? speed : F{}, row + i);
        });
    }
}

// Pressure projection (Stam, Stable Fluids, 1999): makes the field divergence-free except for the source at the touch.
void project(Fluid& f, const Touch& touch) {
    const float x = jittered(touch.x);
    const float y = jittered(touch.y);
    f.ComputeDivergence(f.VelocityTex, f.DivergenceTex, {x, y});
    std::fill(f.PressureTex.row(0), f.PressureTex.row(f.PressureTex.height), 0.0f);
    for (int i = 0; i < f.NumJacobiIterations; ++i) {
        f.Jacobi(f.PressureTex, f.DivergenceTex, f.PressureTexTemp);
        std::swap(f.PressureTex, f.PressureTexTemp);
    }
    f.SubtractGradient(f.VelocityTex, f.PressureTex, f.VelocityTexTemp);
    std::swap(f.VelocityTex, f.VelocityTexTemp);
    zeroOverflows(f.VelocityTex);
}

void upload(const Texture<vec2>& velocity, const Surface_& surface) {
    const auto texels = static_cast<std::size_t>(velocity.width) * static_cast<std::size_t>(velocity.height);
    unsigned char* const bytes = staging.reserve(4 * texels);
    if (!bytes && texels) return;
    packVelocity(velocity.data, texels, bytes);
    glBindTexture(GL_TEXTURE_2D, surface.TextureHandle);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, surface.Width, surface.Height, 0, GL_RGBA, GL_UNSIGNED_BYTE, bytes);
}

}  // namespace

// By contract the frame is not read.
void Fluid::Update(int) {
    const Touch touch = latestTouch(*this);
    {
        const FlushDenormals flush;
        AdvectVelocity(VelocityTex, VelocityTex, VelocityTexTemp, VelocityDissipation);
        std::swap(VelocityTex, VelocityTexTemp);
        if (chooseMargin(*this, touch)) project(*this, touch);
    }
    upload(VelocityTex, Velocity.Ping);
    glViewport(0, 0, InkWidth, InkHeight);
    AdvectDensity(Velocity.Ping, Density.Ping, Density.Pong, DensityDissipation);
    SwapSurfaces(&Density);
}
