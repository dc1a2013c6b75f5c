#include <algorithm>
#include <cstdlib>
#include <utility>

#include "base/scratch.h"
#include "fluid/fluid.h"
#include "fluid/ink_presets.h"
#include "fluid/touch.h"
#include "gl/targets.h"
#include "tshader/flush_denormals.h"
#include "tshader/velocity_packing.h"

namespace {

Scratch<unsigned char> staging("uploading the ink's velocity");

// Chooses how far from the edges a touch must be for its source to act, weakens the source of a slow or medium drag
// that comes closer, and says whether the touch is far enough. By contract a weakened source stays weak until the next
// preset.
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

// Up to 5 pixels to either side, so that a resting finger does not stir the same cells forever. By contract from
// lrand48, which the library does not seed.
float jittered(int position) {
    const float random = static_cast<float>(lrand48()) * 4.656613e-10f;
    return static_cast<float>(
        static_cast<double>(static_cast<float>(position)) + (0.5 - static_cast<double>(random)) * 10.0);
}

// Takes out of the field what the source at the touch and the field itself pile up (Stam, Stable Fluids, 1999).
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
}

void upload(const Texture<vec2>& velocity, const Surface_& surface) {
    if (velocity.empty()) return;  // a view smaller than a cell
    const auto texels = static_cast<std::size_t>(velocity.width) * static_cast<std::size_t>(velocity.height);
    unsigned char* const bytes = staging.reserve(4 * texels);
    if (!bytes) return;
    packVelocity(velocity.data, texels, bytes);
    glBindTexture(GL_TEXTURE_2D, surface.TextureHandle);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, surface.Width, surface.Height, 0, GL_RGBA, GL_UNSIGNED_BYTE, bytes);
}

}  // namespace

// By contract the frame is not read.
void Fluid::Update(int) {
    // A set-up leaves the ink's framebuffer bound, which the water must not draw into.
    if (!VelocityTex.data) return ResetState();
    const Touch touch = latestTouch(*this);
    {
        // A field that fades away ends in denormals.
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
