#include "fluid/fluid.h"
#include "tests/support/gl_test.h"

using Lines = std::vector<std::string>;

namespace {

class Setup : public GlTest {
protected:
    Fluid engine;
};

std::string deleted(const char* member, GLuint name) {
    return std::string("I glDelete ") + member + " = " + std::to_string(name);
}

}  // namespace

TEST_F(Setup, waterIsSetUpTwiceAndEveryOldObjectIsNamedAndDeleted) {
    engine.InitializeSetting(320, 200, false);
    EXPECT_EQ(engine.ScreenWidth, 320);
    EXPECT_EQ(engine.ScreenHeight, 200);
    EXPECT_EQ(engine.InkColor.g, 1.0f);
    EXPECT_EQ(engine.ClearInkValue, 0.0f) << "nothing of the ink is set without it";
    EXPECT_EQ(log.take(), Lines{"I InitializeSetting"});
    engine.InitializeGPU(false);
    const Lines build = {
        "I ripple_vertextShader zorCreateShaderProgram()", "E zorloadShaderScript", "E zorloadShaderScript",
        "I zorCreateShaderProgram"};
    Lines expected = {"I InitializeGPU"};
    expected.insert(expected.end(), build.begin(), build.end());
    EXPECT_EQ(log.take(), expected);
    EXPECT_NE(engine.ripple_program, 0u);

    const GLuint v = engine.v_buf;
    const GLuint h = engine.h_buf;
    const GLuint i = engine.i_buf;
    const GLuint program = engine.ripple_program;
    const GLuint shader = engine.ripple_vertexShader;
    engine.InitializeSetting(200, 320, false);
    EXPECT_EQ(
        log.take(), (Lines{"I InitializeSetting", deleted("v_buf", v), deleted("h_buf", h), deleted("i_buf", i)}));
    engine.InitializeGPU(false);
    expected.insert(expected.begin() + 1, deleted("ripple_program", program));
    EXPECT_EQ(log.take(), expected);
    EXPECT_TRUE(glIsProgram(engine.ripple_program));
    EXPECT_TRUE(engine.ripple_program == program || !glIsProgram(program));
    EXPECT_TRUE(engine.ripple_vertexShader == shader || engine.ripple_fragmentShader == shader || !glIsShader(shader));
}

TEST_F(Setup, inkIsSetUpTwiceAndEveryOldObjectIsNamedAndDeleted) {
    const auto program = [](const char* announcement) {
        return Lines{
            std::string("I ") + announcement + " zorCreateShaderProgram()", "E zorloadShaderScript",
            "E zorloadShaderScript", "I zorCreateShaderProgram"};
    };
    const auto expectedLines = [&](bool again, const Fluid& old) {
        Lines lines = {"I InitializeGPU", "I bInk is true"};
        const auto add = [&](const char* member, GLuint name, const Lines& made) {
            if (again) lines.push_back(deleted(member, name));
            lines.insert(lines.end(), made.begin(), made.end());
        };
        add("ripple_program", old.ripple_program, program("ripple_vertextShader"));
        add("advect_density_program", old.advect_density_program, program("advect_density_program"));
        add("addInk_program", old.addInk_program, program("addInk_program"));
        add("Velocity.Ping.FboHandle", old.Velocity.Ping.FboHandle, {"E CreateSurface"});
        add("Density.Ping.FboHandle", old.Density.Ping.FboHandle, {"E CreateSurface", "E CreateSurface"});
        lines.push_back("I CreateQuad");
        if (again) lines.push_back(deleted("quadvbo", old.quadvbo));
        return lines;
    };
    EXPECT_STREQ(engine.JacobiKernel.name, "");
    engine.InitializeSetting(1085, 1920, true);
    log.take();
    engine.InitializeGPU(true);
    EXPECT_EQ(log.take(), expectedLines(false, engine));
    EXPECT_STREQ(engine.AdvectVelocityKernel.name, "AdvectVelocity");
    EXPECT_STREQ(engine.AdvectDensityKernel.name, "AdvectDensity");
    EXPECT_STREQ(engine.JacobiKernel.name, "Jacobi");
    EXPECT_STREQ(engine.SubtractGradientKernel.name, "SubtractGradient");
    EXPECT_STREQ(engine.ComputeDivergenceKernel.name, "ComputeDivergence");
    EXPECT_STREQ(engine.AddInkKernel.name, "AddInk");
    EXPECT_STREQ(engine.AddVelocityKernel.name, "AddVelocity");
    EXPECT_EQ(engine.VelocityTex.width, 90);
    EXPECT_EQ(engine.DivergenceTex.height, 160);
    EXPECT_EQ(engine.VelocityTexTemp.row(159)[89].y, 0.0f);
    EXPECT_EQ(engine.Velocity.Pong.FboHandle, 0u);
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), static_cast<int>(engine.Density.Pong.FboHandle));
    EXPECT_EQ(binding(GL_BLEND_SRC_ALPHA), GL_SRC_ALPHA);
    EXPECT_EQ(binding(GL_BLEND_DST_ALPHA), GL_ONE_MINUS_SRC_ALPHA);
    EXPECT_FALSE(glIsEnabled(GL_BLEND));
    GLint viewport[4];
    glGetIntegerv(GL_VIEWPORT, viewport);
    EXPECT_EQ(viewport[2], 256);
    EXPECT_EQ(viewport[3], 512);

    engine.ClearSurface(engine.Density.Ping, 1, 1, 1, 1);
    const GLuint pong = engine.Density.Pong.TextureHandle;
    const Fluid& old = engine;
    const Lines expected = expectedLines(true, old);
    engine.InitializeGPU(true);
    EXPECT_EQ(log.take(), expected);
    EXPECT_TRUE(
        engine.Density.Ping.TextureHandle == pong || engine.Density.Pong.TextureHandle == pong ||
        engine.Velocity.Ping.TextureHandle == pong || !glIsTexture(pong));
    glBindFramebuffer(GL_FRAMEBUFFER, engine.Density.Ping.FboHandle);
    EXPECT_EQ(readPixels(10, 10), std::vector<Rgba>(100, Rgba{0, 0, 0, 0})) << "the density is zero again";
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
}

TEST_F(Setup, inkSizesFollowTheViewAndTheParametersHaveTheirValues) {
    struct Row {
        int width, height, gridWidth, gridHeight, inkWidth, inkHeight;
    };
    for (const Row& row :
         {Row{1080, 1920, 90, 160, 256, 512},
          {1920, 1080, 160, 90, 512, 256},
          {1000, 1000, 83, 83, 256, 512},
          {11, 25, 0, 2, 256, 512}}) {
        engine.InitializeSetting(row.width, row.height, true);
        EXPECT_EQ(engine.GridWidth, row.gridWidth);
        EXPECT_EQ(engine.GridHeight, row.gridHeight);
        EXPECT_EQ(engine.InkWidth, row.inkWidth);
        EXPECT_EQ(engine.InkHeight, row.inkHeight);
    }
    const Fluid& f = engine;
    EXPECT_EQ(
        (std::array{
            f.CellSize, f.Radius, f.ImpulseDensity, f.TimeStep, f.GradientScale, f.VelocityDissipation,
            f.DensityDissipation, f.SourceStrength, f.SourceRadius, f.BackwardStepSize, f.ClearInkValue,
            f.InkIntensity}),
        (std::array{2.5f, 2.0f, 200.0f, 0.25f, 0.2f, 0.9f, 0.92f, 50.0f, 40.0f, 1.0f, 1.0f, 0.2f}));
    EXPECT_EQ(f.NumJacobiIterations, 5);
    EXPECT_EQ(f.DragMode, 0);
    EXPECT_EQ(f.BoundaryMargin, 10);
    EXPECT_EQ(f.InkColorOffset, 0.0f) << "left to the frames";
}

TEST_F(Setup, texturesAreReplacedAndSampleWithoutMipmaps) {
    AndroidBitmapInfo info = {};
    info.width = 3;
    info.height = 5;
    info.stride = 99;  // not read
    std::vector<std::uint8_t> pixels(60, 200);
    engine.LoadWaterTextures(info, pixels.data());
    EXPECT_EQ(log.take(), Lines{}) << "the first load of the water texture says nothing";
    const GLuint first = engine.environment;
    engine.LoadWaterTextures(info, pixels.data());
    EXPECT_EQ(log.take(), Lines{deleted("environment", first)});
    engine.LoadPortraitBGTextures(info, pixels.data());
    const GLuint portrait = engine.portraitBG;
    engine.LoadPortraitBGTextures(info, nullptr);
    engine.LoadLandscapeBGTextures(info, pixels.data());
    const GLuint landscape = engine.landscapeBG;
    engine.LoadLandscapeBGTextures(info, pixels.data());
    EXPECT_EQ(
        log.take(), (Lines{
                        "I LoadPortraitBGTextures", "I LoadPortraitBGTextures", deleted("portraitBG", portrait),
                        "I LoadLandscapeBGTextures", "I LoadLandscapeBGTextures", deleted("landscapeBG", landscape)}));
    EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), static_cast<int>(engine.landscapeBG)) << "stays bound";
    for (const GLenum name : {GLenum{GL_TEXTURE_WRAP_S}, GLenum{GL_TEXTURE_WRAP_T}}) {
        GLint value = 0;
        glGetTexParameteriv(GL_TEXTURE_2D, name, &value);
        EXPECT_EQ(value, GL_CLAMP_TO_EDGE);
    }
    for (const GLenum name : {GLenum{GL_TEXTURE_MIN_FILTER}, GLenum{GL_TEXTURE_MAG_FILTER}}) {
        GLint value = 0;
        glGetTexParameteriv(GL_TEXTURE_2D, name, &value);
        EXPECT_EQ(value, GL_LINEAR);
    }
}

TEST_F(Setup, everythingIsMadeAnewInAContextThatReplacesALostOne) {
    engine.InitializeSetting(kSide, kSide, false);
    engine.InitializeGPU(false);
    renewContext();
    engine.InitializeSetting(kSide, kSide, false);
    engine.InitializeGPU(false);
    EXPECT_TRUE(glIsProgram(engine.ripple_program));
    glBindBuffer(GL_ARRAY_BUFFER, engine.v_buf);
    EXPECT_TRUE(glIsBuffer(engine.v_buf));
}
