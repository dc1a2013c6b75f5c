#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <utility>

#include "plain.h"

namespace {

// Random fields on a grid of 12-pixel texels, and every kernel with uniforms as the engine sets them.
struct Scene {
    Image<vec2> velocity, vectors;
    Image<float> pressure, divergence, scalars;
    AdvectVelocityTShaderImpl advect;
    AddVelocityTShaderImpl push;
    ComputeDivergenceTShaderImpl diverge;
    JacobiTShaderImpl jacobi;
    SubtractGradientTShaderImpl subtract;

    Scene(int w, int h, vec2 touch = {40.0f, 30.0f})
        : velocity(w, h), vectors(w, h), pressure(w, h), divergence(w, h), scalars(w, h) {
        velocity.randomize(1);
        pressure.randomize(2);
        divergence.randomize(3);
        advect.VelocityTexture = advect.SourceTexture = push.Velocity = diverge.Velocity = subtract.Velocity = velocity;
        jacobi.Pressure = subtract.Pressure = pressure;
        jacobi.Divergence = divergence;
        advect.output = push.output = subtract.output = vectors;
        diverge.output = jacobi.output = scalars;
        advect.Scale = push.Scale = diverge.Scale = Vec2(12.0f);
        advect.InverseSize = push.InverseSize = diverge.InverseSize = jacobi.InverseSize = subtract.InverseSize =
            1.0f / Vec2(static_cast<float>(w), static_cast<float>(h));
        advect.center = diverge.center = touch;
        advect.delta = {8.0f, -6.0f};
        advect.TimeStep = 0.25f;
        advect.Dissipation = 0.9f;
        diverge.HalfInvCellSize = 0.2f;
        diverge.SourceStrength = 50.0f;
        diverge.SourceRadius = 40.0f;
        jacobi.Alpha = -6.25f;
        jacobi.InverseBeta = 0.25f;
        subtract.GradientScale = 0.2f;
        push.Radius = 30.0f;
        setSegment(touch - Vec2(25.0f, 40.0f), touch);
    }
    void setSegment(vec2 from, vec2 to) {
        const float len = distance(from, to);
        push.previous = from;
        push.current = to;
        push.len = len == 0.0f ? 1.0f : len;
        push.normal = (to - from) / push.len;
    }
};

template <class T>
void expectNear(Image<T>& actual, Image<T>& expected) {
    for (std::size_t i = 0; i < actual.size; ++i) {
        const float wanted = expected.floats()[i];
        ASSERT_NEAR(actual.floats()[i], wanted, 4e-6f * (1.0f + std::abs(wanted)))
            << "float " << i << " of " << actual.width << " x " << actual.height;
    }
}

template <class Kernel, class T>
void expectPlain(Kernel& kernel, Image<T>& out) {
    Image<T> expected(out.width, out.height);
    plain::run(kernel, expected.data);
    out.fill(std::nanf(""));  // shows a texel that the pass misses
    kernel.run();
    expectNear(out, expected);
    EXPECT_TRUE(out.guardsIntact());
    kernel.output.data = nullptr;
    kernel.run();  // without an output, nothing to write
    kernel.output = out;
}

template <class Kernel, class T>
void expectSameFragments(Kernel& kernel, Image<T>& out, int border = 0) {
    Image<T> fragments(out.width, out.height);
    kernel.run();
    std::ranges::copy(out.floats(), fragments.floats().begin());
    // A pass lays the touch over the texels' corners, a fragment over their centres.
    if constexpr (requires { kernel.center; }) kernel.center = kernel.center + 0.5f * kernel.Scale;
    for (int j = border; j < out.height - border; ++j) {
        for (int i = border; i < out.width - border; ++i) {
            const vec2 centre = Vec2(static_cast<float>(i) + 0.5f, static_cast<float>(j) + 0.5f);
            kernel.shaderMain(Vec4(centre, Vec2(0.0f)), fragments.at(i, j));
        }
    }
    expectNear(fragments, out);
}

TEST(Kernels, RunLikeThePlainLoopsAtEverySizeAndTouch) {
    std::mt19937 bits(4);
    std::uniform_real_distribution<float> any(-100.0f, 300.0f);
    for (int width : {0, 1, 2, 3, 4, 5, 6, 7, 9, 13, 90, 91}) {
        for (int height : {0, 1, 2, 3, 5, 9, 160, 161}) {
            for (int drag : {-1, 0, 1, 2}) {
                Scene scene(width, height, {any(bits), any(bits)});
                vec2 from = {any(bits), any(bits)}, to = {any(bits), any(bits)};
                if (drag == 0) to.x = from.x;  // the push reaches farthest along an axis
                if (drag == 1) to.y = from.y;
                scene.setSegment(from, to);
                scene.advect.drag = drag;
                expectPlain(scene.advect, scene.vectors);
                expectPlain(scene.push, scene.vectors);
                expectPlain(scene.subtract, scene.vectors);
                expectPlain(scene.diverge, scene.scalars);
                expectPlain(scene.jacobi, scene.scalars);
            }
        }
    }
}

TEST(Kernels, ShaderMainReadsTheSameTexelsAsRun) {
    Scene scene(23, 17);
    scene.advect.drag = 2;
    expectSameFragments(scene.advect, scene.vectors);
    expectSameFragments(scene.push, scene.vectors);
    expectSameFragments(scene.subtract, scene.vectors);
    expectSameFragments(scene.diverge, scene.scalars);
    expectSameFragments(scene.jacobi, scene.scalars, 1);
}

TEST(AdvectVelocity, StaysInsideTheSourceForAnyVelocity) {
    const float infinity = std::numeric_limits<float>::infinity();
    const float values[] = {std::nanf(""), infinity, -infinity, 3e38f, -3e38f, 1e9f, -1e9f, 0.0f};
    for (const auto& [width, height] : {std::pair{4, 1}, {5, 4}, {9, 7}}) {
        Scene scene(width, height);
        Image<vec2> wild(width, height);
        for (std::size_t i = 0; i < wild.size; ++i) wild.floats()[i] = values[(i * 5 + i / 8) % 8];
        scene.advect.VelocityTexture = wild;
        scene.advect.run();
        for (float value : scene.vectors.floats()) EXPECT_LE(std::abs(value), 20.0f);
    }
}

TEST(AdvectVelocity, DragReachesTexelCornersNearerThan25Pixels) {
    Scene scene(6, 5, {0.0f, 0.0f});
    scene.velocity.fill(0.0f);
    const auto moved = [&] {
        scene.advect.run();
        return 30 - std::ranges::count(scene.vectors.floats(), 0.0f) / 2;
    };
    EXPECT_EQ(moved(), 0) << "still water stays still";
    scene.advect.drag = 2;
    EXPECT_EQ(moved(), 6);
    EXPECT_FLOAT_EQ(scene.vectors.at(0, 2).x, 0.5f * 8.0f * 0.9f);
    scene.advect.drag = 1;
    EXPECT_EQ(moved(), 6);
    EXPECT_FLOAT_EQ(scene.vectors.at(2, 0).y, -0.5f * -6.0f * 0.9f);
    scene.advect.center = {12.0f - 25.0f, 12.0f};
    EXPECT_EQ(moved(), 3) << "texel (1, 1) is exactly 25 pixels away";
}

TEST(AddVelocity, PushesStrictlyInsideTheBandOnly) {
    Scene scene(12, 12);
    scene.velocity.fill(0.0f);
    scene.push.Radius = 24.0f;
    scene.setSegment({30.0f, 66.0f}, {90.0f, 66.0f});  // through the centres of row 5, from column 2 to column 7
    scene.push.run();
    const auto pushed = [&](int i, int j) { return scene.vectors.at(i, j); };
    EXPECT_EQ(pushed(2, 6).x, 0.0f) << "foot on the start";
    EXPECT_EQ(pushed(7, 6).y, 0.0f) << "foot on the end";
    EXPECT_EQ(pushed(4, 5).x, 0.0f) << "on the segment";
    EXPECT_EQ(pushed(4, 7).y, 0.0f) << "exactly the radius away";
    EXPECT_NEAR(pushed(4, 6).x, 12.0f * 0.1f * 36.0f, 1e-4f);
    EXPECT_NEAR(pushed(4, 6).y, 12.0f * 0.1f * 12.0f, 1e-4f);
    EXPECT_NEAR(pushed(4, 4).y, -12.0f * 0.1f * 12.0f, 1e-4f);
    scene.setSegment({66.0f, 66.0f}, {66.0f, 66.0f});
    scene.push.run();
    EXPECT_EQ(std::ranges::count(scene.vectors.floats(), 0.0f), 288) << "a resting finger pushes nothing";
}

TEST(Projection, OfEvenFieldsIsTheSourceDiscAlone) {
    Scene scene(9, 7, {12.0f, 12.0f});
    scene.velocity.fill(3.5f);
    scene.pressure.fill(0.0f);
    scene.diverge.SourceRadius = 24.0f;
    scene.diverge.run();
    scene.jacobi.Divergence = scene.scalars;
    scene.jacobi.output = scene.divergence;
    scene.jacobi.run();
    for (int j = 0; j < 7; ++j) {
        for (int i = 0; i < 9; ++i) {
            const bool inside = (i - 1) * (i - 1) + (j - 1) * (j - 1) < 4;  // exactly 2 texels away is outside
            const bool border = i == 0 || j == 0 || i == 8 || j == 6;
            EXPECT_EQ(scene.scalars.at(i, j), inside ? -50.0f : 0.0f) << i << ", " << j;
            EXPECT_EQ(scene.divergence.at(i, j), inside && !border ? 78.125f : 0.0f) << i << ", " << j;
        }
    }
    scene.pressure.fill(7.0f);
    scene.subtract.run();
    EXPECT_EQ(std::ranges::count(scene.vectors.floats(), 3.5f), 126) << "even pressure pushes nothing";
}

}  // namespace
