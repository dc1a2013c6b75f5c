#include <cmath>
#include <cstdlib>
#include <random>
#include <string_view>

#include "shaders/shaders.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tshader/velocity_packing.h"

namespace {

// The passes on a small target, against the CPU kernels of the same operations.
class InkPasses : public GlTest {
protected:
    static constexpr int kWidth = 24;
    static constexpr int kHeight = 40;
    static constexpr std::size_t kTexels = kWidth * kHeight;

    void SetUp() override {
        GlTest::SetUp();
        resetGestures();
        // Screen positions beyond 1,024 and squares beyond 65,504 are out of half precision's reach.
        engine.InitializeSetting(1200, 2000, true);
        engine.GridWidth = engine.InkWidth = kWidth;
        engine.GridHeight = engine.InkHeight = kHeight;
        engine.InitializeGPU(true);
        // 85 pixels beside the centre of texel (12, 21): just outside the reach of the touch.
        POSITION_X = 710;
        POSITION_Y = 925;
        log.take();
    }

    // Mesa's software rasteriser of last resort is exact; the other one filters in 8 bits.
    static bool isExact() {
        const char* driver = std::getenv("GALLIUM_DRIVER");
        return driver && std::string_view(driver) == "softpipe";
    }

    void setDensity(const Surface_& surface, const std::vector<float>& density) {
        std::vector<Rgba> texels;
        for (const float value : density) {
            const double whole = std::floor(value);
            const long fraction = std::lround((value - whole) * 255);
            texels.push_back({static_cast<std::uint8_t>(whole), static_cast<std::uint8_t>(fraction), 0, 0});
        }
        glBindTexture(GL_TEXTURE_2D, surface.TextureHandle);
        glTexImage2D(
            GL_TEXTURE_2D, 0, GL_RGBA, surface.Width, surface.Height, 0, GL_RGBA, GL_UNSIGNED_BYTE, texels.data());
    }

    void setVelocity(const std::vector<vec2>& velocity) {
        std::vector<unsigned char> bytes(4 * velocity.size());
        packVelocity(velocity.data(), velocity.size(), bytes.data());
        glBindTexture(GL_TEXTURE_2D, engine.Velocity.Ping.TextureHandle);
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, kWidth, kHeight, 0, GL_RGBA, GL_UNSIGNED_BYTE, bytes.data());
    }

    static std::vector<float> density(const Surface_& surface) {
        glBindFramebuffer(GL_FRAMEBUFFER, surface.FboHandle);
        std::vector<float> values;
        for (const Rgba& texel : readPixels(surface.Width, surface.Height)) {
            values.push_back(static_cast<float>(texel[0]) + static_cast<float>(texel[1]) / 255.0f);
        }
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return values;
    }

    // Smooth, so that the filter's weights matter little, with all fractions in it.
    static std::vector<float> someDensity() {
        std::vector<float> values;
        for (int j = 0; j < kHeight; ++j) {
            for (int i = 0; i < kWidth; ++i) {
                values.push_back(static_cast<float>(50 + 45 * std::sin(i * 0.21) * std::cos(j * 0.13)));
            }
        }
        // As the texture holds them.
        for (float& v : values) v = std::floor(v) + static_cast<float>(std::lround((v - std::floor(v)) * 255)) / 255.0f;
        return values;
    }

    template <class Kernel>
    static std::vector<float> everyTexel(Kernel& kernel, float centre) {
        std::vector<float> values;
        for (int j = 0; j < kHeight; ++j) {
            for (int i = 0; i < kWidth; ++i) {
                float value = 0;
                kernel.shaderMain(Vec4(static_cast<float>(i) + centre, static_cast<float>(j) + centre, 0, 1), value);
                values.push_back(std::min(value, 127.0f));
            }
        }
        return values;
    }

    static double largestDifference(const std::vector<float>& a, const std::vector<float>& b) {
        double largest = 0;
        for (std::size_t i = 0; i < a.size(); ++i) largest = std::max(largest, std::fabs(double{a[i]} - double{b[i]}));
        return largest;
    }

    static constexpr double kHalfStep = 0.5 / 255 + 1e-3;  // rounding to the texture's last bit
    Fluid engine;
};

}  // namespace

TEST_F(InkPasses, injectionAddsWhatTheKernelAdds) {
    AddInkTShaderImpl kernel;
    std::vector<float> before = someDensity();
    kernel.Source = {before.data(), kWidth, kHeight};
    kernel.Scale = Vec2(1200.0f / kWidth, 2000.0f / kHeight);
    kernel.InverseSize = Vec2(1.0f / kWidth, 1.0f / kHeight);
    kernel.previous = Vec2(320, 500);
    kernel.current = Vec2(900, 1500);
    kernel.len = distance(kernel.previous, kernel.current);
    kernel.normal = (kernel.current - kernel.previous) / kernel.len;
    engine.Radius = kernel.Radius = 300;
    engine.ImpulseDensity = kernel.ImpulseDensity = 30;
    for (const int mode : {-1, 0, 1, 2}) {
        kernel.mode = mode;
        setDensity(engine.Density.Ping, before);
        engine.AddInk(engine.Density.Ping, engine.Density.Pong, mode, {320, 500}, {900, 1500}, 30);
        const auto expected = everyTexel(kernel, 0.5f);
        EXPECT_GT(largestDifference(expected, before), 0.2) << "this stroke adds something";
        EXPECT_LE(largestDifference(density(engine.Density.Pong), expected), kHalfStep + (isExact() ? 0 : 1e-3))
            << mode;
    }
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
}

TEST_F(InkPasses, strokesHaveFlatEndsAndSaturate) {
    setDensity(engine.Density.Ping, std::vector<float>(kTexels, 100));
    engine.Radius = 5000;
    engine.ImpulseDensity = 50;
    engine.AddInk(engine.Density.Ping, engine.Density.Pong, 2, {0, 1000}, {1200, 1000}, 50);
    const auto line = density(engine.Density.Pong);
    EXPECT_EQ(line[20 * kWidth + 12], 127.0f) << "saturated on the segment";

    engine.AddInk(engine.Density.Ping, engine.Density.Pong, 2, {0, 1000}, {600, 1000}, 50);
    const auto half = density(engine.Density.Pong);
    EXPECT_GT(half[20 * kWidth + 11], 100.0f);
    EXPECT_EQ(half[20 * kWidth + 12], 100.0f) << "beyond the end nothing is added, however large the radius";

    engine.AddInk(engine.Density.Ping, engine.Density.Pong, 2, {600, 1000}, {600, 1000}, 50);
    EXPECT_EQ(density(engine.Density.Pong), std::vector<float>(kTexels, 100))
        << "a segment without length adds nothing";
    engine.Radius = 0;
    engine.AddInk(engine.Density.Ping, engine.Density.Pong, -1, {600, 1000}, {600, 1000}, 50);
    EXPECT_EQ(density(engine.Density.Pong), std::vector<float>(kTexels, 100)) << "nor does a radius of 0";
}

// With a velocity grid of the density's own size both samplers address the same texels: the kernel's runs from 0 at the
// first texel's centre to 1 at the last one's, so it gets coordinates measured from there.
TEST_F(InkPasses, advectionCarriesWhatTheKernelCarries) {
    std::vector<vec2> velocity;
    for (std::size_t i = 0; i < kTexels; ++i) {
        const auto a = static_cast<float>(i);
        velocity.push_back(Vec2(9 * std::sin(a * 0.01f), 7 * std::cos(a * 0.017f)));
    }
    AdvectDensityTShaderImpl kernel;
    std::vector<float> before = someDensity();
    kernel.VelocityTexture = {velocity.data(), kWidth, kHeight};
    kernel.SourceTexture = {before.data(), kWidth, kHeight};
    kernel.InverseSize = Vec2(1.0f / (kWidth - 1), 1.0f / (kHeight - 1));
    kernel.Scale = Vec2(1200.0f / kWidth, 2000.0f / kHeight);
    kernel.center = Vec2(710, 1075) - 0.5f * kernel.Scale;
    kernel.TimeStep = 0.9f * 0.25f;
    kernel.Dissipation = 0.92f;
    setVelocity(velocity);
    for (const int drag : {-1, 2}) {
        for (const float backward : {1.0f, 0.3f}) {
            engine.DragMode = kernel.drag = drag;
            engine.BackwardStepSize = kernel.BackwardStepSize = backward;
            setDensity(engine.Density.Ping, before);
            glViewport(0, 0, kWidth, kHeight);
            engine.AdvectDensity(engine.Velocity.Ping, engine.Density.Ping, engine.Density.Pong, 0.92f);
            const auto expected = everyTexel(kernel, 0.0f);
            // The packed velocity is rounded down by up to 1 / 255, which moves a sample a little; neighbours differ
            // by up to 10. The other driver also rounds a filtered whole part to a whole number, twice.
            EXPECT_LE(largestDifference(density(engine.Density.Pong), expected), isExact() ? 0.012 : 1.0)
                << "drag " << drag << ", step " << backward;
        }
    }
}

TEST_F(InkPasses, advectionClearsCopiesAndKeepsTheInkUnderTheFinger) {
    const auto before = someDensity();
    setVelocity(std::vector<vec2>(kTexels, Vec2(0, 0)));
    const auto advected = [&](float dissipation) {
        setDensity(engine.Density.Ping, before);
        glViewport(0, 0, kWidth, kHeight);
        engine.AdvectDensity(engine.Velocity.Ping, engine.Density.Ping, engine.Density.Pong, dissipation);
        return density(engine.Density.Pong);
    };
    EXPECT_EQ(advected(0), std::vector<float>(kTexels, 0)) << "a dissipation of 0 clears in one pass";
    EXPECT_LE(largestDifference(advected(1), before), 1.0 / 255 + 1e-4);

    setVelocity(std::vector<vec2>(kTexels, Vec2(8, 0)));
    POSITION_X = 12 * 50 + 25;
    POSITION_Y = 2000 - (20 * 50 + 25);
    engine.DragMode = 0;
    const std::size_t touched = 20 * kWidth + 12;
    EXPECT_NEAR(advected(1)[touched], before[touched], 0.05) << "at the touch itself the ink stays";
    engine.DragMode = 2;
    EXPECT_GT(std::fabs(advected(1)[touched] - before[touched]), 0.3);
}

TEST_F(InkPasses, injectionKeepsAwayFromTheEdgesButRecordsTheStroke) {
    engine.BoundaryMargin = 60;
    engine.Radius = 100;
    POSITION_X = 60;
    POSITION_Y = 1000;
    const GLuint ping = engine.Density.Ping.TextureHandle;
    engine.Inject(-1, 600, 900, 610, 1000, {0.1f, 0.2f, 0.3f});
    EXPECT_EQ(engine.Density.Ping.TextureHandle, ping) << "no pass, no swap";
    EXPECT_EQ(engine.Current.x, 610.0f);
    EXPECT_EQ(engine.Current.y, 1000.0f);
    EXPECT_EQ(engine.Previous.y, 1100.0f);
    EXPECT_EQ(engine.InkColor.b, 0.3f);
    POSITION_X = 61;
    engine.Inject(-1, 600, 900, 625, 975, {0.1f, 0.2f, 0.3f});
    EXPECT_NE(engine.Density.Ping.TextureHandle, ping);
    EXPECT_EQ(density(engine.Density.Ping)[20 * kWidth + 12], 127.0f);
}
