// The tuning constants of the ink: the engine parameters that the set-up, each gesture and the border of the view set.
// The thresholds and durations of gestures are variables in jni/globals.h, because an app may change them at run time.
#pragma once

// A tap, or the speed class of a drag. The shaders and kernels branch on these values.
enum StrokeKind { kTap = -1, kSlowDrag = 0, kMediumDrag = 1, kFastDrag = 2 };

struct InkPreset {
    int dragMode;
    float radius;               // of injected ink and velocity, pixels
    float impulseDensity;       // density added by one injection; a texel holds up to 127
    float sourceStrength;       // subtracted from the divergence around the touch, which drives the flow outwards
    float sourceRadius;         // pixels
    float velocityDissipation;  // factor per frame
    float densityDissipation;   // factor per frame
};

// The radius and the source strength are multiplied by the number of the tap's frame; the strength only for the first
// acc_step frames, after which it is 0.
inline constexpr InkPreset kTapPreset = {
    .dragMode = kTap,
    .radius = 8.0f,
    .impulseDensity = 200.0f,
    .sourceStrength = 12.0f,
    .sourceRadius = 40.0f,
    .velocityDissipation = 0.94f,
    .densityDissipation = 0.92f};
inline constexpr float kTapBackwardStep = 0.1f;  // back-trace scale per frame of the tap, so that new ink moves slowly

// The radius and the source strength are multiplied by TouchPressure.
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

// A fast drag also calls Perturb.
inline constexpr InkPreset kFastPreset = {
    .dragMode = kFastDrag,
    .radius = 30.0f,
    .impulseDensity = 40.0f,
    .sourceStrength = 20.0f,
    .sourceRadius = 4.0f,
    .velocityDissipation = 0.96f,
    .densityDissipation = 0.92f};

// In force from the set-up to the first gesture.
inline constexpr InkPreset kSetUpPreset = {
    .dragMode = kSlowDrag,
    .radius = 2.0f,
    .impulseDensity = 200.0f,
    .sourceStrength = 50.0f,
    .sourceRadius = 40.0f,
    .velocityDissipation = 0.9f,
    .densityDissipation = 0.92f};

// Set when a drag ends, so that velocity and ink fade.
inline constexpr float kReleasedVelocityDissipation = 0.9f;
inline constexpr float kReleasedDensityDissipation = 0.9f;

// Solver.
inline constexpr int kCellPixels = 12;  // side of a cell of the velocity grid
inline constexpr float kCellSize = 2.5f;
inline constexpr int kJacobiIterations = 5;
inline constexpr float kTimeStep = 0.25f;  // cells per unit of velocity and frame
inline constexpr float kGradientScale = 0.2f;
inline constexpr int kLongInkSide = 512;  // density texels along the longer side of the view
inline constexpr int kShortInkSide = 256;

// Drawing and advection of the ink. A channel is divided by
// 1 + intensity * density * ((1.5 - kInkColorOffset) / (colour + kColorRaise) - 1).
inline constexpr float kBackwardStep = 1.0f;       // scale of the density's back-trace
inline constexpr float kSetUpInkIntensity = 0.2f;  // by contract set by the set-up, and not used by any frame
inline constexpr float kInkIntensity = 0.02f;
inline constexpr float kInkColorOffset = 0.7f;
inline constexpr double kColorRaise = 0.05;  // keeps the divisor from 0

// Margins: a touch injects only if it is more than this many pixels away from every edge. Slow and medium drags within
// kMargin have smaller margins and weaker sources.
inline constexpr int kSetUpMargin = 10;
inline constexpr int kMargin = 60;
inline constexpr int kSlowMargin = 12;
inline constexpr float kSlowEdgeStrength = 40.0f;
inline constexpr float kSlowEdgeRadius = 4.0f;
inline constexpr int kMediumMargin = 10;
inline constexpr float kMediumEdgeStrength = 2.0f;
inline constexpr float kMediumEdgeRadius = 2.0f;
