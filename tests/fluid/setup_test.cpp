#include "fluid/fluid.h"
#include "tests/support/gl_test.h"

namespace {

struct Setup : GlTest {
    void setUp(int width, int height, bool withInk) {
        engine.InitializeSetting(width, height, withInk);
        engine.InitializeGPU(withInk);
    }

    Fluid engine;
};

}  // namespace

TEST_F(Setup, logsEveryStepAndEveryObjectThatItReplaces) {
    std::vector<std::uint8_t> pixels(3 * 5 * 4, 200);
    AndroidBitmapInfo info = {};
    info.width = 3;
    info.height = 5;
    for (int i = 0; i < 2; ++i) {
        setUp(1085, 1920, i == 1);
        engine.LoadPortraitBGTextures(info, pixels.data());
        engine.LoadLandscapeBGTextures(info, nullptr);
        engine.LoadWaterTextures(info, pixels.data());
    }
    engine.InitializeGPU(true);
    std::string lines;
    for (const std::string& line : log.take()) lines += line.substr(0, line.find_last_not_of("0123456789") + 1) + '\n';
    const std::string build = "E zorloadShaderScript\nE zorloadShaderScript\nI zorCreateShaderProgram\n";
    const std::string ripple = "I ripple_vertextShader zorCreateShaderProgram()\n" + build;
    const std::string advect = "I advect_density_program zorCreateShaderProgram()\n" + build;
    const std::string addInk = "I addInk_program zorCreateShaderProgram()\n" + build;
    EXPECT_EQ(
        lines, "I InitializeSetting\nI InitializeGPU\n" + ripple +
                   "I LoadPortraitBGTextures\nI LoadLandscapeBGTextures\n" +
                   "I InitializeSetting\nI glDelete v_buf = \nI glDelete h_buf = \nI glDelete i_buf = \n" +
                   "I InitializeGPU\nI bInk is true\nI glDelete ripple_program = \n" + ripple + advect + addInk +
                   "E CreateSurface\nE CreateSurface\nE CreateSurface\nI CreateQuad\n" +
                   "I LoadPortraitBGTextures\nI glDelete portraitBG = \n" +
                   "I LoadLandscapeBGTextures\nI glDelete landscapeBG = \nI glDelete environment = \n" +
                   "I InitializeGPU\nI bInk is true\nI glDelete ripple_program = \n" + ripple +
                   "I glDelete advect_density_program = \n" + advect + "I glDelete addInk_program = \n" + addInk +
                   "I glDelete Velocity.Ping.FboHandle = \nE CreateSurface\n" +
                   "I glDelete Density.Ping.FboHandle = \nE CreateSurface\nE CreateSurface\n" +
                   "I CreateQuad\nI glDelete quadvbo = \n");
}

TEST_F(Setup, setsSizesAndParameters) {
    engine.InitializeSetting(320, 200, false);
    EXPECT_EQ(std::pair(engine.ScreenWidth, engine.ScreenHeight), std::pair(320, 200));
    EXPECT_EQ((std::array{engine.InkColor.r, engine.InkColor.g, engine.InkColor.b}), (std::array{1.0f, 1.0f, 1.0f}));
    EXPECT_EQ(engine.ClearInkValue, 0.0f) << "a set-up without ink sets no ink parameter";
    for (const auto& [view, grid, ink] :
         {std::tuple(std::pair(1085, 1920), std::pair(90, 160), std::pair(256, 512)),
          {{1920, 1080}, {160, 90}, {512, 256}},
          {{1000, 1000}, {83, 83}, {256, 512}},
          {{11, 25}, {0, 2}, {256, 512}}}) {
        engine.InitializeSetting(view.first, view.second, true);
        EXPECT_EQ(std::pair(engine.GridWidth, engine.GridHeight), grid);
        EXPECT_EQ(std::pair(engine.InkWidth, engine.InkHeight), ink);
    }
    const Fluid& f = engine;
    EXPECT_EQ(
        (std::array{
            f.CellSize, f.Radius, f.ImpulseDensity, f.TimeStep, f.GradientScale, f.VelocityDissipation,
            f.DensityDissipation, f.SourceStrength, f.SourceRadius, f.BackwardStepSize, f.ClearInkValue, f.InkIntensity,
            f.InkColorOffset}),
        (std::array{2.5f, 2.0f, 200.0f, 0.25f, 0.2f, 0.9f, 0.92f, 50.0f, 40.0f, 1.0f, 1.0f, 0.2f, 0.0f}));
    EXPECT_EQ((std::array{f.NumJacobiIterations, f.DragMode, f.BoundaryMargin}), (std::array{5, 0, 10}));
}

TEST_F(Setup, clearsTheFieldsAndLeavesTheDocumentedState) {
    setUp(1080, 1920, true);
    std::ranges::fill_n(engine.VelocityTex.data, 90 * 160, vec2{1.0f, 1.0f});
    engine.ClearSurface(engine.Density.Ping, 1, 1, 1, 1);
    setUp(1080, 1920, true);
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), static_cast<int>(engine.Density.Pong.FboHandle));
    EXPECT_EQ(binding(GL_BLEND_SRC_ALPHA), GL_SRC_ALPHA);
    EXPECT_EQ(binding(GL_BLEND_DST_ALPHA), GL_ONE_MINUS_SRC_ALPHA);
    EXPECT_FALSE(glIsEnabled(GL_BLEND));
    EXPECT_EQ(viewport(), (std::array{0, 0, 256, 512}));
    EXPECT_EQ(std::pair(engine.DivergenceTex.width, engine.DivergenceTex.height), std::pair(90, 160));
    for (const auto& texture : {engine.VelocityTex, engine.VelocityTexTemp}) {
        EXPECT_EQ(texture.row(0)->x, 0.0f);
        EXPECT_EQ(texture.row(159)[89].y, 0.0f);
    }
    for (const Surface_& density : {engine.Density.Ping, engine.Density.Pong}) {
        glBindFramebuffer(GL_FRAMEBUFFER, density.FboHandle);
        EXPECT_EQ(readPixels(256, 512), std::vector<Rgba>(256 * 512, Rgba{}));
    }

    setUp(1080, 1920, true);
    setUp(1080, 1920, false);
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0) << "a set-up without ink binds framebuffer 0";
}
