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
    GLint filter = 0;
    glGetTexParameteriv(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, &filter);
    EXPECT_EQ(filter, GL_LINEAR);
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
