#include <gtest/gtest.h>

#include <limits>
#include <random>
#include <span>

#include "reference/ink_grid.h"

namespace {

const float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinity = std::numeric_limits<float>::infinity();

template <class T>
std::span<const float> floats(const std::vector<T>& texels) {
    return {reinterpret_cast<const float*>(texels.data()), texels.size() * sizeof(T) / sizeof(float)};
}

// Expects exact equality, because four lanes add in the same order as one. NaN equals nothing, so a texel that a pass
// does not write fails.
template <class T>
void expectSame(const char* what, const std::vector<T>& actual, const std::vector<T>& expected) {
    EXPECT_TRUE(std::ranges::equal(floats(actual), floats(expected))) << what;
}

void setSegment(AddVelocityTShaderImpl& push, vec2 from, vec2 to) {
    const float length = distance(from, to);
    push.previous = from;
    push.current = to;
    push.len = length == 0.0f ? 1.0f : length;
    push.normal = (to - from) / push.len;
}

// A grid in which every pass has an effect around the touch. The outputs are initialized with NaN.
struct Scene : InkGrid {
    Scene(int columns, int rows, int drag, vec2 touch, vec2 from, vec2 to) : InkGrid(12 * columns, 12 * rows) {
        for (auto* const texels : {&advected, &projected, &pushed}) std::ranges::fill(*texels, Vec2(kNan));
        for (auto* const texels : {&divergence, &pressureTemp}) std::ranges::fill(*texels, kNan);
        advect.drag = drag;
        advect.center = diverge.center = touch;
        diverge.SourceStrength = 50.0f;
        diverge.SourceRadius = 40.0f;
        setSegment(push, from, to);
    }
};

template <class Kernel, class T>
void expectSameFragments(Kernel& kernel, const std::vector<T>& texels, int border = 0) {
    const std::vector<T> rows = texels;
    // run measures the distance to the touch from a texel's corner, shaderMain from its centre.
    if constexpr (requires { kernel.center; }) kernel.center = kernel.center + 0.5f * kernel.Scale;
    for (int j = border; j < kernel.output.height - border; ++j) {
        for (int i = border; i < kernel.output.width - border; ++i) {
            const vec2 centre = Vec2(static_cast<float>(i) + 0.5f, static_cast<float>(j) + 0.5f);
            std::vector<T> fragment(1);
            kernel.shaderMain(Vec4(centre, Vec2(0.0f)), fragment[0]);
            const auto texel =
                floats(rows).subspan(static_cast<std::size_t>(j * kernel.output.width + i) * floats(fragment).size());
            for (std::size_t k = 0; k < floats(fragment).size(); ++k) {
                ASSERT_NEAR(floats(fragment)[k], texel[k], 1e-5f * (1.0f + std::abs(texel[k]))) << i << ", " << j;
            }
        }
    }
}

}  // namespace

// Touches at integer pixels put many texels exactly at the radius of the touch or of the segment.
TEST(Kernels, matchThePlainLoops) {
    std::mt19937 random(4);
    const auto pixel = [&random] { return static_cast<float>(static_cast<int>(random() % 300) - 80); };
    for (const int width : {1, 2, 3, 4, 5, 6, 7, 9, 13, 90, 91}) {
        for (const int height : {1, 2, 3, 5, 9, 40, 41}) {
            for (const int drag : {-1, 0, 1, 2}) {
                SCOPED_TRACE(testing::Message() << width << " x " << height << ", drag " << drag);
                const vec2 touch = {pixel(), pixel()}, from = {pixel(), pixel()};
                vec2 to = {pixel(), pixel()};
                if (drag == 0) to.x = from.x;  // Axis-parallel segments affect the most texels.
                if (drag == 1) to.y = from.y;
                if (width == 5) to = from;
                Scene actual(width, height, drag, touch, from, to);
                Scene expected(width, height, drag, touch, from, to);
                // The back-trace uses extreme velocities; the sampled values are finite.
                std::vector<vec2> wild = actual.velocity;
                const float wildest[] = {kNan, kInfinity, -kInfinity, 3e38f, -3e38f, 1e9f, -1e9f};
                for (std::size_t i = 0; i < wild.size(); i += 3) wild[i] = {wildest[i % 7], wildest[i / 3 % 7]};
                if (height % 2 == 1) {
                    actual.advect.VelocityTexture.data = expected.advect.VelocityTexture.data = wild.data();
                }
                actual.wholeFrame(kLibrary);
                expected.wholeFrame(kScalar);
                expectSame("advection", actual.advected, expected.advected);
                expectSame("divergence", actual.divergence, expected.divergence);
                expectSame("pressure", actual.pressureTemp, expected.pressureTemp);
                expectSame("gradient", actual.projected, expected.projected);
                expectSame("forcing", actual.pushed, expected.pushed);
                EXPECT_EQ(actual.bytes, expected.bytes);
            }
        }
    }
}

TEST(Kernels, supportPlacementNewAndEmptyGrids) {
    alignas(JacobiTShaderImpl) unsigned char place[sizeof(JacobiTShaderImpl)];
    auto* const placed = new (place) JacobiTShaderImpl;
    placed->run();
    EXPECT_EQ(placed->name[0], '\0');
    placed->~JacobiTShaderImpl();
    InkGrid(0, 36).wholeFrame(kLibrary);
    InkGrid(36, 0).wholeFrame(kLibrary);
}

TEST(Kernels, shaderMainMatchesRun) {
    Scene scene(23, 17, 2, {40.0f, 30.0f}, {15.0f, -10.0f}, {140.0f, 130.0f});
    scene.wholeFrame(kLibrary);
    expectSameFragments(scene.advect, scene.advected);
    expectSameFragments(scene.diverge, scene.divergence);
    expectSameFragments(scene.subtract, scene.projected);
    expectSameFragments(scene.push, scene.pushed);
    scene.relax.Pressure = {scene.pressure.data(), scene.width, scene.height};
    scene.relax.output = {scene.pressureTemp.data(), scene.width, scene.height};
    scene.relax.run();
    expectSameFragments(scene.relax, scene.pressureTemp, 1);
}
