#include <algorithm>
#include <cstdlib>
#include <utility>

#include "fluid/fluid.h"
#include "fluid/touch_point.h"
#include "jni/globals.h"
#include "tshader/flush_denormals.h"
#include "tshader/scratch.h"
#include "tshader/velocity_packing.h"

namespace {

Scratch<unsigned char> staging("uploading the ink's velocity");

// Chooses how far from the edges a touch must be for its source to act, weakens the source of a slow or medium drag
// that comes closer, and says whether the touch is far enough. By contract a weakened source stays weak until the next
// preset.
bool chooseMargin(Fluid& f) {
    f.BoundaryMargin = 60;
    if (f.DragMode == 0 && !isTouchInside(f, 60)) {
        f.SourceRadius = 4.0f;
        f.SourceStrength = 40.0f;
        f.BoundaryMargin = 12;
    } else if (f.DragMode == 1 && !isTouchInside(f, 60)) {
        f.BoundaryMargin = 10;
        if (!isTouchInside(f, 10)) {
            f.SourceRadius = 2.0f;
            f.SourceStrength = 2.0f;
        }
    }
    return isTouchInside(f, f.BoundaryMargin);
}

// Up to 5 pixels to either side, so that a resting finger does not stir the same cells forever. By contract from
// lrand48, which the library does not seed.
float jittered(int position) {
    const float random = static_cast<float>(lrand48()) * 4.656613e-10f;
    return static_cast<float>(
        static_cast<double>(static_cast<float>(position)) + (0.5 - static_cast<double>(random)) * 10.0);
}

// Takes out of the field what the source at the touch and the field itself pile up (Stam, Stable Fluids, 1999).
void project(Fluid& f) {
    const float x = jittered(POSITION_X);
    const float y = jittered(flippedTouchY(f));
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
    {
        // A field that fades away ends in denormals.
        const FlushDenormals flush;
        AdvectVelocity(VelocityTex, VelocityTex, VelocityTexTemp, VelocityDissipation);
        std::swap(VelocityTex, VelocityTexTemp);
        if (chooseMargin(*this)) project(*this);
    }
    upload(VelocityTex, Velocity.Ping);
    glViewport(0, 0, InkWidth, InkHeight);
    AdvectDensity(Velocity.Ping, Density.Ping, Density.Pong, DensityDissipation);
    SwapSurfaces(&Density);
}
