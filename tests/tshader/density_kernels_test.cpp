#include <gtest/gtest.h>

#include <cmath>
#include <numeric>

#include "plain.h"
#include "tshader/AddInkTShaderImpl.h"
#include "tshader/AdvectDensityTShaderImpl.h"

namespace {

TEST(AdvectDensity, TakesSmallerStepsNearTheTouch) {
    Image<vec2> velocity(100, 1);
    velocity.fill(4.0f);
    Image<float> density(100, 1);
    std::iota(density.floats().begin(), density.floats().end(), 0.0f);
    AdvectDensityTShaderImpl kernel;
    kernel.VelocityTexture = velocity;
    kernel.SourceTexture = density;
    kernel.InverseSize = Vec2(0.01f, 1.0f);
    kernel.TimeStep = 0.5f;
    kernel.BackwardStepSize = 3.0f;
    kernel.Dissipation = 0.5f;
    kernel.Scale = Vec2(4.0f, 1.0f);
    kernel.center = Vec2(200.0f, 0.5f);
    // The density is its column, so a result tells how many pixels the fragment has gone back.
    const auto wentBack = [&](float x) {
        float out;
        kernel.shaderMain(Vec4(x, 0.5f, 0.0f, 0.0f), out);
        return x - out / 0.5f / 0.99f;
    };
    kernel.drag = 1;
    EXPECT_NEAR(wentBack(50.0f), 0.0f, 1e-4f);
    EXPECT_NEAR(wentBack(60.0f), 40.0f * 0.0075f * 2.0f, 1e-4f);
    EXPECT_NEAR(wentBack(70.0f), 6.0f, 1e-4f) << "exactly 80 pixels away";
    kernel.drag = 2;
    EXPECT_NEAR(wentBack(50.0f), 6.0f, 1e-4f);
}

TEST(AddInk, FallsOffAroundThePointAndAcrossTheSegment) {
    Image<float> density(8, 8);
    density.fill(1.0f);
    AddInkTShaderImpl kernel;
    kernel.Source = density;
    kernel.Scale = Vec2(10.0f);
    kernel.InverseSize = Vec2(0.125f);
    kernel.previous = Vec2(15.0f, 35.0f);
    kernel.current = Vec2(55.0f, 35.0f);
    kernel.normal = Vec2(1.0f, 0.0f);
    kernel.len = 40.0f;
    kernel.ImpulseDensity = 20.0f;
    kernel.Radius = 20.0f;
    const auto added = [&](float screenX, float screenY) {
        float out;
        kernel.shaderMain(Vec4(screenX / 10.0f, screenY / 10.0f, 0.0f, 0.0f), out);
        return out - 1.0f;
    };
    kernel.mode = 2;
    EXPECT_EQ(added(25.0f, 35.0f), 20.0f);
    EXPECT_NEAR(added(25.0f, 45.0f), 20.0 * std::exp(-100.0 / 320.0), 1e-5);
    EXPECT_EQ(added(25.0f, 55.0f), 0.0f) << "exactly the radius away";
    EXPECT_EQ(added(15.0f, 35.0f), 0.0f) << "at the start";
    EXPECT_EQ(added(55.0f, 35.0f), 0.0f) << "at the end";
    for (int mode : {-1, 0, 1}) {
        kernel.mode = mode;
        EXPECT_EQ(added(55.0f, 35.0f), 20.0f);
        EXPECT_NEAR(added(55.0f, 44.0f), 2.0f, 1e-6f);
        EXPECT_EQ(added(55.0f, 55.0f), 0.0f);
    }
}

}  // namespace
