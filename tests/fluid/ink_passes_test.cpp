#include <cmath>
#include <cstdlib>
#include <string_view>

#include "fluid/fluid.h"
#include "fluid/touch.h"
#include "jni/globals.h"
#include "reference/kernel_set.h"
#include "tests/support/gl_test.h"

namespace {

constexpr int kWidth = 24;
constexpr int kHeight = 40;
constexpr std::size_t kTexels = kWidth * kHeight;

using Density = std::vector<float>;

double largestDifference(const Density& a, const Density& b) {
    double largest = 0;
    for (std::size_t i = 0; i < a.size(); ++i) largest = std::max(largest, std::fabs(double{a[i]} - double{b[i]}));
    return largest;
}

float decoded(const Rgba& texel) {
    return static_cast<float>(texel[0]) + static_cast<float>(texel[1]) / 255.0f;
}

// Runs shaderMain for every texel; `centre` is the fragment coordinate of the first one.
template <class Kernel>
Density everyTexel(Kernel& kernel, float centre) {
    Density values(kTexels);
    for (std::size_t i = 0; i < kTexels; ++i) {
        kernel.shaderMain(
            Vec4(static_cast<float>(i % kWidth) + centre, static_cast<float>(i / kWidth) + centre, 0, 1), values[i]);
        values[i] = std::min(values[i], 127.0f);
    }
    return values;
}

// Compares the GPU passes on a small target with the CPU kernels.
class InkPasses : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        // Positions above 1,024 lose precision in a half float, and squares above 65,504 overflow it.
        engine.InitializeSetting(1200, 2000, true);
        engine.GridWidth = engine.InkWidth = kWidth;
        engine.GridHeight = engine.InkHeight = kHeight;
        engine.InitializeGPU(true);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        // A smooth density, so that the precision of the filter weights has little effect. It contains all fractions.
        std::vector<Rgba> texels;
        for (std::size_t i = 0; i < kTexels; ++i) {
            const double along = 0.21 * static_cast<double>(i % kWidth), up = 0.13 * static_cast<double>(i / kWidth);
            const double value = 60 + 60 * std::sin(along) * std::cos(up);
            const auto byte = [](double x) { return static_cast<std::uint8_t>(x); };
            texels.push_back({byte(value), byte((value - std::floor(value)) * 255), 0, 0});
            before.push_back(decoded(texels.back()));
        }
        fill(engine.Density.Ping, texels.data());
    }

    // Mesa's softpipe filters exactly, llvmpipe with weights of 8 bits.
    static bool isExact() {
        const char* driver = std::getenv("GALLIUM_DRIVER");
        return driver && std::string_view(driver) == "softpipe";
    }

    static void fill(const Surface_& surface, const void* texels) {
        glBindTexture(GL_TEXTURE_2D, surface.TextureHandle);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, kWidth, kHeight, 0, GL_RGBA, GL_UNSIGNED_BYTE, texels);
    }

    static Density densityOf(const Surface_& surface) {
        glBindFramebuffer(GL_FRAMEBUFFER, surface.FboHandle);
        Density values;
        for (const Rgba& texel : readPixels(kWidth, kHeight)) values.push_back(decoded(texel));
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return values;
    }

    Fluid engine;
    Density before;
};

}  // namespace

TEST_F(InkPasses, injectionMatchesTheKernel) {
    AddInkTShaderImpl kernel;
    kernel.Source = {before.data(), kWidth, kHeight};
    kernel.Scale = Vec2(1200.0f / kWidth, 2000.0f / kHeight);
    kernel.InverseSize = Vec2(1.0f / kWidth, 1.0f / kHeight);
    engine.Radius = kernel.Radius = 300;
    engine.ImpulseDensity = kernel.ImpulseDensity = 30;
    kernel.current = {903.3f, 1503.3f};
    for (const int mode : {-1, 0, 1, 2}) {
        for (vec2 previous : {vec2{320.3f, 500.4f}, {903.3f, 500.4f}, kernel.current}) {
            SCOPED_TRACE(testing::Message() << "mode " << mode << " from " << previous.x << ", " << previous.y);
            kernel.mode = mode;
            kernel.previous = previous;
            kernel.len = distance(kernel.previous, kernel.current);
            const bool hasLength = kernel.len > 0;
            kernel.normal = hasLength ? (kernel.current - kernel.previous) / kernel.len : Vec2(0);
            engine.AddInk(
                engine.Density.Ping, engine.Density.Pong, mode, {previous.x, previous.y}, {903.3f, 1503.3f}, 7);
            const Density expected = everyTexel(kernel, 0.5f);
            EXPECT_EQ(largestDifference(expected, before) > 0.2, mode != 2 || hasLength) << "the pass adds ink";
            EXPECT_LE(
                largestDifference(densityOf(engine.Density.Pong), expected), 0.5 / 255 + (isExact() ? 1e-3 : 2e-3));
        }
    }
    // The ends of the segment are exclusive.
    kernel.Scale = kernel.normal = Vec2(0, 1);
    kernel.previous = Vec2(0);
    kernel.len = 4;
    float ink = 0;
    for (const float y : {0.0f, 2.0f, 4.0f}) {
        kernel.shaderMain(Vec4(0, y, 0, 0), ink);
        EXPECT_EQ(ink > before[0], y == 2) << y;
    }
    const Segment none = segmentBetween({5, 7}, {5, 7});
    EXPECT_EQ((std::array{none.normal.x, none.normal.y, none.length}), (std::array{0.0f, 0.0f, 1.0f}));
}

// The velocity grid has the density's size. The kernel's sampler has 0 at the first texel's centre and 1 at the last
// one's, so the kernel gets coordinates relative to the first centre.
TEST_F(InkPasses, advectionMatchesTheKernel) {
    std::vector<vec2> velocity;
    for (std::size_t i = 0; i < kTexels; ++i) {
        const auto a = static_cast<float>(i);
        velocity.push_back(Vec2(9 * std::sin(a * 0.01f), 7 * std::cos(a * 0.017f)));
    }
    std::vector<unsigned char> bytes(4 * kTexels);
    kScalar.packing(velocity.data(), kTexels, bytes.data());
    fill(engine.Velocity.Ping, bytes.data());
    AdvectDensityTShaderImpl kernel;
    kernel.VelocityTexture = {velocity.data(), kWidth, kHeight};
    kernel.SourceTexture = {before.data(), kWidth, kHeight};
    kernel.InverseSize = Vec2(1.0f / (kWidth - 1), 1.0f / (kHeight - 1));
    kernel.Scale = Vec2(1200.0f / kWidth, 2000.0f / kHeight);
    kernel.TimeStep = 0.9f * 0.25f;
    // 85 pixels from the centre of texel (12, 21), which is just outside the touch's radius of 80.
    POSITION_X = 710;
    POSITION_Y = 925;
    kernel.center = Vec2(710, 1075) - 0.5f * kernel.Scale;
    for (const int drag : {-1, 1, 2}) {
        for (const float backward : {1.0f, 0.3f}) {
            SCOPED_TRACE(testing::Message() << "drag " << drag << ", step " << backward);
            engine.DragMode = kernel.drag = drag;
            engine.BackwardStepSize = kernel.BackwardStepSize = backward;
            kernel.Dissipation = 0.92f * backward;
            glViewport(0, 0, kWidth, kHeight);
            engine.AdvectDensity(engine.Velocity.Ping, engine.Density.Ping, engine.Density.Pong, 0.92f * backward);
            // Packing rounds the velocity down by up to 1 / 255, and neighbouring densities differ by up to 13.
            // llvmpipe also rounds the filtered whole part to an integer, twice.
            EXPECT_LE(
                largestDifference(densityOf(engine.Density.Pong), everyTexel(kernel, 0.0f)), isExact() ? 0.016 : 1.0);
        }
    }
    kernel.drag = 1;
    std::array<float, 3> carried;
    for (const int i : {0, 1, 2}) {
        kernel.center = kernel.Scale * Vec2(12, 20) + Vec2(79.0f + static_cast<float>(i), 0);
        kernel.shaderMain(Vec4(12, 20, 0, 0), carried[static_cast<std::size_t>(i)]);
    }
    EXPECT_NE(carried[0], carried[1]);
    EXPECT_EQ(carried[1], carried[2]) << "at 80 pixels and beyond, the touch has no effect";
}

TEST_F(InkPasses, injectionNearAnEdgeOnlyRecordsTheStroke) {
    engine.BoundaryMargin = 60;
    engine.Radius = 100;
    const GLuint ping = engine.Density.Ping.TextureHandle;
    POSITION_Y = 1000;
    for (const int x : {60, 61}) {
        POSITION_X = x;
        engine.Inject(-1, 600, 900, 625, 975, {0.1f, 0.2f, 0.3f});
        EXPECT_EQ(engine.Density.Ping.TextureHandle != ping, x == 61) << "an injection swaps the pair";
        EXPECT_EQ(std::pair(engine.Current.x, engine.Current.y), std::pair(625.0f, 1025.0f));
        EXPECT_EQ(std::pair(engine.Previous.x, engine.Previous.y), std::pair(600.0f, 1100.0f));
        EXPECT_EQ(engine.InkColor.b, 0.3f);
    }
    EXPECT_EQ(densityOf(engine.Density.Ping)[20 * kWidth + 12], 127.0f) << "saturated";
}
