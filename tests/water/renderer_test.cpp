#include <cmath>

#include "fluid/fluid.h"
#include "host/picture.h"
#include "jni/natives.h"
#include "tests/support/gl_test.h"
#include "tests/support/test_pictures.h"
#include "tests/support/water_reference.h"
#include "water/mesh.h"

namespace {

constexpr int kVertices = 9;

class Renderer : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        setUp(false);
        load(&Fluid::LoadPortraitBGTextures, portrait);
        load(&Fluid::LoadLandscapeBGTextures, landscape);
        load(&Fluid::LoadWaterTextures, water);
        positions.resize(3 * kVertices * kVertices);
        indices.resize(6 * (kVertices - 1) * (kVertices - 1));
        fillPositions(positions.data(), kVertices * kVertices, 10, 12, kVertices, kVertices);
        fillIndices(indices.data(), kVertices, kVertices);
        log.take();
    }

    void setUp(bool ink) {
        withInk = ink;
        engine.InitializeSetting(kSide, kSide, ink);
        engine.InitializeGPU(ink);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
    }

    void load(void (Fluid::*loader)(AndroidBitmapInfo, void*), Picture& picture) {
        AndroidBitmapInfo info = {};
        info.width = static_cast<std::uint32_t>(picture.width);
        info.height = static_cast<std::uint32_t>(picture.height);
        (engine.*loader)(info, picture.rgba.data());
    }

    std::vector<Rgba> render(const reference::Scene& s, bool isLandscape = false) {
        std::vector<float> attribs;
        for (int c = 0; c < s.n; ++c) {
            for (int r = 0; r < s.n; ++r) {
                for (const int k : {c * s.n + r, std::min(c + 1, s.n - 1) * s.n + r, c * s.n + std::max(r - 1, 0)}) {
                    attribs.push_back(s.heights[static_cast<std::size_t>(k)]);
                }
            }
        }
        const std::array<float, 16> mvp = {
            static_cast<float>(s.scaleX), 0, 0, 0, 0, static_cast<float>(s.scaleY), 0, 0, 0, 0, 1, 0, 0, 0, 0, 1};
        engine.Ripple_Render(
            positions.data(), attribs.data(), indices.data(), static_cast<int>(positions.size()),
            static_cast<int>(attribs.size()), static_cast<int>(indices.size()), mvp.data(), 10, 12, s.n, s.n,
            static_cast<float>(s.refractiveIndex), 0.5f, static_cast<float>(s.alphaRatio1 * 2), 1.0f,
            static_cast<float>(s.fresnelRatio), static_cast<float>(s.specularRatio), static_cast<float>(s.exponent),
            withInk, isLandscape);
        return readPixels();
    }

    reference::Scene scene(float wave) {
        reference::Scene s = {kVertices, 10, 12, 0.2, 1.0 / 6, {}, 1.5, 0.4, 0.7, 4, 12, 5.5, &portrait, &water};
        for (int i = 0; i < kVertices * kVertices; ++i) {
            s.heights.push_back(wave * static_cast<float>(std::sin(i * 0.9) + std::cos(i * 0.37)));
        }
        return s;
    }

    // `divisor` is what the ink of a pixel divides its colour by.
    template <class Divisor>
    static double largestError(
        const std::vector<Rgba>& pixels, const reference::Scene& s, int allowedOutliers, Divisor divisor) {
        std::vector<double> errors;
        for (int y = 0; y < kSide; ++y) {
            for (int x = 0; x < kSide; ++x) {
                const reference::Vec3 color = reference::waterColor(
                    s, ((x + 0.5) / kSide * 2 - 1) / s.scaleX, ((y + 0.5) / kSide * 2 - 1) / s.scaleY);
                double error = 0;
                for (std::size_t c = 0; c < 3; ++c) {
                    const double expected = std::min(color[c] / divisor(x, y, c), 1.0) * 255;
                    error = std::max(error, std::fabs(expected - pixels[static_cast<std::size_t>(y * kSide + x)][c]));
                }
                errors.push_back(error);
            }
        }
        std::sort(errors.begin(), errors.end());
        return errors[errors.size() - 1 - static_cast<std::size_t>(allowedOutliers)];
    }

    static double largestError(const std::vector<Rgba>& pixels, const reference::Scene& s, int allowedOutliers) {
        return largestError(pixels, s, allowedOutliers, [](int, int, std::size_t) { return 1.0; });
    }

    Fluid engine;
    bool withInk = false;
    Picture portrait = smoothPicture(48, 96, 1);
    Picture landscape = smoothPicture(96, 48, 2);
    Picture water = smoothPicture(32, 32, 3);
    std::vector<float> positions;
    std::vector<std::int16_t> indices;
};

}  // namespace

// The rasteriser and half-precision colours differ from the formulas by a level or two; along edges of triangles a
// pixel may fall to the other side.
TEST_F(Renderer, everyPixelFollowsTheFormulas) {
    for (const float wave : {0.0f, 0.15f, 0.6f, 2.0f}) {
        const reference::Scene s = scene(wave);
        EXPECT_LE(largestError(render(s), s, 40), 3.0) << "waves of " << wave;
    }
    EXPECT_GT(largestError(render(scene(0.6f)), scene(0.0f), 40), 20.0) << "waves must show at all";
}

TEST_F(Renderer, aFlatSurfaceShowsThePictureAloneWhateverTheLight) {
    reference::Scene s = scene(0.0f);
    const auto plain = render(s);
    s.specularRatio = 90;
    s.alphaRatio1 = 1;
    s.refractiveIndex = 2.0;
    EXPECT_EQ(render(s), plain);

    s.background = &landscape;
    EXPECT_LE(largestError(render(s, true), s, 40), 3.0) << "the landscape switch selects the other picture";
}

TEST_F(Renderer, theDrawLeavesTheStatedStateBehind) {
    glViewport(0, 0, 3, 3);
    glEnable(GL_CULL_FACE);
    glEnable(GL_DEPTH_TEST);
    render(scene(0.3f));
    EXPECT_EQ(binding(GL_CURRENT_PROGRAM), static_cast<int>(engine.ripple_program));
    EXPECT_EQ(binding(GL_ARRAY_BUFFER_BINDING), static_cast<int>(engine.v_buf));
    EXPECT_EQ(binding(GL_ELEMENT_ARRAY_BUFFER_BINDING), static_cast<int>(engine.i_buf));
    EXPECT_EQ(binding(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
    GLint viewport[4];
    glGetIntegerv(GL_VIEWPORT, viewport);
    EXPECT_EQ(viewport[2], kSide);
    for (GLuint unit = 0; unit < 4; ++unit) {
        glActiveTexture(GL_TEXTURE0 + unit);
        EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), 0) << unit;
    }
    for (const char* name : {"aPosition", "aHeights"}) {
        GLint enabled = -1;
        glGetVertexAttribiv(
            static_cast<GLuint>(glGetAttribLocation(engine.ripple_program, name)), GL_VERTEX_ATTRIB_ARRAY_ENABLED,
            &enabled);
        EXPECT_EQ(enabled, GL_FALSE) << name;
    }
    EXPECT_TRUE(glIsEnabled(GL_CULL_FACE) && glIsEnabled(GL_DEPTH_TEST));
    EXPECT_TRUE(log.take().empty());
}

// Fractions alone in the density show whether they are read, a slope down the view whether it is the right way up.
TEST_F(Renderer, inkDividesEachChannelByItsTint) {
    setUp(true);
    engine.InkColor = {0.2f, 0.45f, 0.8f};
    engine.InkColorOffset = 0.7f;
    engine.ClearInkValue = 1.0f;
    // A texel for each pixel, so that the driver's filter takes no part.
    const auto whole = [](int y) { return y / 6; };
    std::vector<Rgba> texels;
    for (int y = 0; y < kSide; ++y)
        texels.insert(texels.end(), kSide, {static_cast<std::uint8_t>(whole(y)), 128, 77, 99});
    glBindTexture(GL_TEXTURE_2D, engine.Density.Ping.TextureHandle);
    glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, kSide, kSide, 0, GL_RGBA, GL_UNSIGNED_BYTE, texels.data());
    reference::Scene s = scene(0.9f);
    s.specularLimit = 4.5;
    s.specularRatio = 40;
    s.exponent = 2;
    for (const float intensity : {0.3f, 0.0f}) {
        engine.InkIntensity = intensity;
        const auto divisor = [&](int, int y, std::size_t c) {
            return 1 + intensity * (whole(y) + 128 / 255.0) * (0.8 / std::array{0.2, 0.45, 0.8}[c] - 1);
        };
        EXPECT_LE(largestError(render(s), s, 60, divisor), 4.0) << "intensity " << intensity;
    }
    engine.InkIntensity = 0.3f;
    engine.ClearInkValue = 0.0f;
    EXPECT_LE(largestError(render(s), s, 60), 4.0) << "hidden ink does not show";
    EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), 0);
}
