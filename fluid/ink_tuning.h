// The feel of the ink: what a set-up, a gesture and the edge of the view write into the engine. Everything that a
// person tunes stands here; globals.h has the thresholds and lengths of gestures, which an app may change at run time.
#pragma once

// How ink is laid: by a tap, or by a drag of one of three speeds. The two passes over the density and the velocity's
// advection branch on these codes.
enum StrokeKind { kTap = -1, kSlowDrag = 0, kMediumDrag = 1, kFastDrag = 2 };

struct InkPreset {
    int dragMode;
    float radius;               // of ink and of pushes, pixels
    float impulseDensity;       // ink of one injection; a texel holds up to 127
    float sourceStrength;       // lowers the divergence around the touch, which drives the water apart
    float sourceRadius;         // pixels
    float velocityDissipation;  // factor on the flow, a frame
    float densityDissipation;   // factor on the ink, a frame
};

// Radius and strength a frame of the tap: the blot grows while it lasts, its source for the first acc_step frames.
inline constexpr InkPreset kTapPreset = {
    .dragMode = kTap,
    .radius = 8.0f,
    .impulseDensity = 200.0f,
    .sourceStrength = 12.0f,
    .sourceRadius = 40.0f,
    .velocityDissipation = 0.94f,
    .densityDissipation = 0.92f};
inline constexpr float kTapBackwardStep = 0.1f;  // a frame of the tap: young blots hardly move

// Radius and strength a unit of pressure weight.
inline constexpr InkPreset kSlowPreset = {
    .dragMode = kSlowDrag,
    .radius = 40.0f,
    .impulseDensity = 100.0f,
    .sourceStrength = 45.0f,
    .sourceRadius = 20.0f,
    .velocityDissipation = 0.8f,
    .densityDissipation = 0.94f};

inline constexpr InkPreset kMediumPreset = {
    .dragMode = kMediumDrag,
    .radius = 25.0f,
    .impulseDensity = 150.0f,
    .sourceStrength = 10.0f,
    .sourceRadius = 20.0f,
    .velocityDissipation = 0.94f,
    .densityDissipation = 0.92f};

// Also pushes the flow along the stroke.
inline constexpr InkPreset kFastPreset = {
    .dragMode = kFastDrag,
    .radius = 30.0f,
    .impulseDensity = 40.0f,
    .sourceStrength = 20.0f,
    .sourceRadius = 4.0f,
    .velocityDissipation = 0.96f,
    .densityDissipation = 0.92f};

// After a set-up, until the first gesture.
inline constexpr InkPreset kSetUpPreset = {
    .dragMode = kSlowDrag,
    .radius = 2.0f,
    .impulseDensity = 200.0f,
    .sourceStrength = 50.0f,
    .sourceRadius = 40.0f,
    .velocityDissipation = 0.9f,
    .densityDissipation = 0.92f};

// A released drag sets these factors for the ink that fades.
inline constexpr float kReleasedVelocityDissipation = 0.9f;
inline constexpr float kReleasedDensityDissipation = 0.9f;

// The solver, from the set-up on.
inline constexpr int kCellPixels = 12;  // side of a cell of the velocity grid
inline constexpr float kCellSize = 2.5f;
inline constexpr int kJacobiIterations = 5;
inline constexpr float kTimeStep = 0.25f;  // also written by every ink frame
inline constexpr float kGradientScale = 0.2f;
inline constexpr int kLongInkSide = 512;  // of the density, texels along the longer side of the view
inline constexpr int kShortInkSide = 256;

// How the ink is shown and carried.
inline constexpr float kBackwardStep = 1.0f;       // whole back-trace; also written by every ink frame
inline constexpr float kSetUpInkIntensity = 0.2f;  // darkening a unit of density; by contract, no frame shows it
inline constexpr float kInkIntensity = 0.02f;      // from then on
inline constexpr float kInkColorOffset = 0.7f;     // a channel is divided by 1 + w * ((1.5 - offset) / colour - 1)
inline constexpr double kColorRaise = 0.05;        // on each channel of the host's colour, which divides

// Near the edge: how far inside the view, in pixels, a touch must be to inject, and the weaker sources of slow and
// medium drags that are nearer.
inline constexpr int kSetUpMargin = 10;
inline constexpr int kMargin = 60;
inline constexpr int kSlowMargin = 12;
inline constexpr float kSlowEdgeStrength = 40.0f;
inline constexpr float kSlowEdgeRadius = 4.0f;
inline constexpr int kMediumMargin = 10;
inline constexpr float kMediumEdgeStrength = 2.0f;
inline constexpr float kMediumEdgeRadius = 2.0f;
