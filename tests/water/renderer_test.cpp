#include "water/renderer.h"

#include <cmath>
#include <functional>
#include <random>

#include "fluid/fluid.h"
#include "gl/picture_texture.h"
#include "tests/support/gl_test.h"
#include "water/mesh.h"

namespace {

constexpr int kView = 32;
constexpr std::size_t kPixels = kView * kView;
constexpr int kWidth = 10;  // of the mesh, model units
constexpr int kHeight = 12;

using Vec3 = std::array<double, 3>;

double dot(const Vec3& a, const Vec3& b) {
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

Vec3 normalized(const Vec3& v) {
    const double length = std::sqrt(dot(v, v));
    return {v[0] / length, v[1] / length, v[2] / length};
}

// A picture of wide stripes.
struct Stripes {
    int width, height;
    double along, across;

    Vec3 at(double u, double v) const {
        const double phase = along * std::clamp(u, 0.5 / width, 1 - 0.5 / width) +
                             across * std::clamp(v, 0.5 / height, 1 - 0.5 / height);
        return {0.4 + 0.3 * std::sin(phase), 0.4 + 0.3 * std::sin(phase + 2), 0.4 + 0.3 * std::sin(phase + 4)};
    }
    void load(GLuint& texture) const {
        std::vector<Rgba> texels;
        for (int i = 0; i < width * height; ++i) {
            const Vec3 color = at((i % width + 0.5) / width, (i / width + 0.5) / height);
            const auto level = [&color](std::size_t c) {
                return static_cast<std::uint8_t>(std::lround(color[c] * 255));
            };
            texels.push_back({level(0), level(1), level(2), 255});
        }
        AndroidBitmapInfo info = {};
        info.width = static_cast<std::uint32_t>(width);
        info.height = static_cast<std::uint32_t>(height);
        makePictureTexture(texture, info, texels.data());
    }
};

constexpr Stripes kPortrait = {128, 64, 12, 5};
constexpr Stripes kLandscape = {64, 128, -5, 14};
constexpr Stripes kSurface = {32, 32, 5, 3};

// The transform rotates model space by 90 degrees counter-clockwise: up becomes left. Every vertex is at the centre of
// a pixel, so no value is interpolated: the vertex in column c and row r is the pixel in row c from the bottom, column
// r.
constexpr float kLeft = 2.0f * (kView - 1) / kView / kHeight;
constexpr float kUp = 2.0f * (kView - 1) / kView / kWidth;
constexpr std::array<float, 16> kTransform = {0, kUp, 0, 0, -kLeft, 0, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};

Vec3 transformed(double x, double y, double z) {
    return {-kLeft * y, kUp * x, z};
}

// Computes the shaders' colour of a vertex at (x, y); h holds its height and those of its neighbours in x and y.
Vec3 colorAt(double x, double y, const float* h, const WaterLight& light, const Stripes& picture, double brightest) {
    double nx = (double{h[0]} - double{h[1]}) * 0.25;
    double ny = (double{h[0]} - double{h[2]}) * 0.25;
    const double nz = std::sqrt(nx * nx + ny * ny + 1);
    nx /= nz;
    ny /= nz;
    Vec3 ray = normalized({x, y, h[0] * 0.25 + 30});
    const double bend = dot(ray, {nx, ny, 1}) * (light.refractiveIndex - 1.0);
    ray[0] += nx * bend;
    ray[1] += ny * bend;
    const double reach = (30.9 - h[0] * 0.25) / ray[2];
    const Vec3 behind = picture.at(
        (ray[0] * reach + x) / (kWidth / 2.0) * 0.25 + 0.5, (ray[1] * reach + y) / (kHeight / 2.0) * -0.25 + 0.5);
    const Vec3 surface = kSurface.at(nx * 0.5 + 0.5 + y / kWidth * 0.25, ny * 0.5 + 0.5 + x / kHeight * 0.25);

    const Vec3 position = transformed(x, y, 0);
    const Vec3 sun = transformed(5, -5, 1);
    const Vec3 view = normalized({-position[0], -position[1], 1 - position[2]});
    const Vec3 half = normalized({view[0] + sun[0], view[1] + sun[1], view[2] + sun[2]});
    const Vec3 normal = normalized({nx, ny, 0.6});
    const double shine = std::pow(std::max(dot(normal, half), 0.0), double{light.exponent});
    const double specular = std::clamp(light.specularRatio * shine, 1.0, brightest);
    const double facing = std::max(dot(normal, {5, -5, 1}), 0.0);
    const double fresnel =
        light.alphaMix * light.alphaScale1 + light.fresnelRatio * std::clamp(facing - 0.99, 0.0, 0.3);
    const double weight = std::min(std::fabs(double{h[0]}), 1.13) * specular * fresnel;
    return {weight * surface[0] + behind[0], weight * surface[1] + behind[1], weight * surface[2] + behind[2]};
}

class Renderer : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        fillPositions(positions.data(), kPixels, kWidth, kHeight, kView, kView);
        fillIndices(indices.data(), kView, kView);
        // Random heights; the slopes increase along the view.
        std::mt19937 random(1);
        std::uniform_real_distribution<float> height(-1.6f, 1.6f);
        for (std::size_t i = 0; i < kPixels; ++i) {
            const float steepness = static_cast<float>(i) / kPixels;
            heights[3 * i] = height(random);
            for (const std::size_t k : {1u, 2u}) heights[3 * i + k] = heights[3 * i] + steepness * height(random);
        }
        setUp(false);
        kPortrait.load(engine.portraitBG);
        kLandscape.load(engine.landscapeBG);
        kSurface.load(engine.environment);
    }

    void setUp(bool ink) {
        withInk = ink;
        engine.InitializeSetting(kView, kView, ink);
        engine.InitializeGPU(ink);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
    }

    void draw(bool landscape) {
        engine.Ripple_Render(
            positions.data(), heights.data(), indices.data(), 3 * kPixels, 3 * kPixels,
            static_cast<int>(indices.size()), kTransform.data(), kWidth, kHeight, kView, kView, light.refractiveIndex,
            light.alphaMix, light.alphaScale1, light.alphaScale2, light.fresnelRatio, light.specularRatio,
            light.exponent, withInk, landscape);
    }

    // Compares the picture with colorAt, divided by divisor(row, channel).
    using Divisor = std::function<double(std::size_t row, std::size_t channel)>;
    void expectFormulas(
        bool landscape, const Divisor& divisor = [](auto...) { return 1.0; }) {
        draw(landscape);
        const std::vector<Rgba> pixels = readPixels(kView, kView);
        // The tolerance covers 8-bit filter weights and half-precision mediump. The driver may omit pixels exactly on
        // the mesh's edge.
        for (std::size_t c = 1; c < kView - 1; ++c) {
            for (std::size_t r = 1; r < kView - 1; ++r) {
                const std::size_t i = c * kView + r;
                const Vec3 color = colorAt(
                    double{positions[3 * i]}, double{positions[3 * i + 1]}, &heights[3 * i], light,
                    landscape ? kLandscape : kPortrait, withInk ? 4.5 : 5.5);
                for (std::size_t k = 0; k < 3; ++k) {
                    const double expected = std::min(color[k] / divisor(c, k), 1.0) * 255;
                    ASSERT_NEAR(pixels[c * kView + r][k], expected, 3.0) << r << ", " << c << ", channel " << k;
                }
            }
        }
    }

    Fluid engine;
    bool withInk = false;
    WaterLight light = {1.5f, 0.5f, 0.2f, 1.0f, 0.5f, 12.0f, 6.0f};
    std::vector<float> positions = std::vector<float>(3 * kPixels);
    std::vector<float> heights = positions;
    std::vector<std::int16_t> indices = std::vector<std::int16_t>(6 * (kView - 1) * (kView - 1));
};

}  // namespace

TEST_F(Renderer, pixelsMatchTheFormulas) {
    expectFormulas(false);
    expectFormulas(true);
    heights.assign(heights.size(), 0.0f);
    expectFormulas(false);
}

// The density's fraction byte detects a shader that ignores it; its vertical gradient detects a flipped texture.
TEST_F(Renderer, visibleInkDividesEachChannel) {
    setUp(true);
    engine.InkColor = {0.2f, 0.45f, 0.8f};
    engine.InkColorOffset = 0.7f;
    std::vector<Rgba> texels;
    for (int i = 0; i < kView * kView; ++i) texels.push_back({static_cast<std::uint8_t>(i / kView / 3), 128, 77, 99});
    glBindTexture(GL_TEXTURE_2D, engine.Density.Ping.TextureHandle);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, kView, kView, 0, GL_RGBA, GL_UNSIGNED_BYTE, texels.data());
    for (const float shown : {1.0f, 0.0f}) {
        engine.InkIntensity = 0.3f;
        engine.ClearInkValue = shown;
        expectFormulas(false, [&](std::size_t row, std::size_t channel) {
            const double density = static_cast<double>(row / 3) + 128 / 255.0;
            return 1 + 0.3 * double{shown} * density * (0.8 / std::array{0.2, 0.45, 0.8}[channel] - 1);
        });
    }
}

TEST_F(Renderer, leavesTheDocumentedState) {
    setUp(true);
    log.take();
    glViewport(0, 0, 3, 3);
    glEnable(GL_CULL_FACE);
    glEnable(GL_DEPTH_TEST);
    draw(false);
    EXPECT_EQ(viewport(), (std::array{0, 0, kView, kView}));
    EXPECT_EQ(binding(GL_CURRENT_PROGRAM), static_cast<int>(engine.ripple_program));
    EXPECT_EQ(binding(GL_ARRAY_BUFFER_BINDING), static_cast<int>(engine.v_buf));
    EXPECT_EQ(binding(GL_ELEMENT_ARRAY_BUFFER_BINDING), static_cast<int>(engine.i_buf));
    EXPECT_EQ(binding(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
    EXPECT_TRUE(glIsEnabled(GL_CULL_FACE) && glIsEnabled(GL_DEPTH_TEST));
    for (GLuint i = 0; i < 4; ++i) {
        GLint enabled = -1;
        glGetVertexAttribiv(i, GL_VERTEX_ATTRIB_ARRAY_ENABLED, &enabled);
        EXPECT_EQ(enabled, GL_FALSE) << i;
        glActiveTexture(GL_TEXTURE0 + i);
        EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), 0) << i;
    }
    EXPECT_TRUE(log.take().empty());
}
