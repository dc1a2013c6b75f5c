#include "fluid/fluid.h"
#include "gl/shader_program.h"
#include "shaders/shaders.h"
#include "tests/support/gl_test.h"

namespace {

constexpr char kStripes[] =
    "precision mediump float; varying vec2 v_texCoord;"
    "void main() { gl_FragColor = vec4(v_texCoord, 0.0, 1.0); }";

class Toolkit : public GlTest {
protected:
    Fluid engine;
};

}  // namespace

TEST_F(Toolkit, aShaderThatDoesNotCompileIsLoggedAndGivesNoProgram) {
    EXPECT_EQ(zorloadShaderScript(GL_FRAGMENT_SHADER, "void main() { nonsense }"), 0u);
    auto lines = log.take();
    ASSERT_EQ(lines.size(), 2u);
    EXPECT_EQ(lines[0], "E zorloadShaderScript");
    EXPECT_EQ(lines[1].find("E Could not compile shader 35632:\n"), 0u) << lines[1];

    const GLuint vertex = zorloadShaderScript(GL_VERTEX_SHADER, kQuadVert);
    EXPECT_NE(vertex, 0u);
    EXPECT_EQ(log.take(), std::vector<std::string>{"E zorloadShaderScript"});
    EXPECT_EQ(zorCreateShaderProgram(vertex, 0), 0u);
    EXPECT_EQ(zorCreateShaderProgram(0, vertex), 0u);
    EXPECT_EQ(log.take(), (std::vector<std::string>{"I zorCreateShaderProgram", "I zorCreateShaderProgram"}));

    EXPECT_EQ(zorloadShaderScript(GL_TEXTURE_2D, kQuadVert), 0u) << "no such kind of shader";
    EXPECT_EQ(glGetError(), static_cast<GLenum>(GL_INVALID_ENUM));
}

TEST_F(Toolkit, aProgramThatDoesNotLinkIsLoggedAndLeavesTheShaders) {
    const GLuint vertex = zorloadShaderScript(GL_VERTEX_SHADER, kQuadVert);
    const GLuint fragment = zorloadShaderScript(
        GL_FRAGMENT_SHADER,
        "precision mediump float; varying vec3 missing; void main() { gl_FragColor = missing.xyzz; }");
    log.take();
    EXPECT_EQ(zorCreateShaderProgram(vertex, fragment), 0u);
    const auto lines = log.take();
    ASSERT_EQ(lines.size(), 2u);
    EXPECT_EQ(lines[1].find("E Could not link program:\n"), 0u) << lines[1];
    EXPECT_TRUE(glIsShader(vertex));
    EXPECT_TRUE(glIsShader(fragment));
}

TEST_F(Toolkit, theQuadCoversItsTargetAndLeavesTheStatedBindings) {
    const GLuint program = zorCreateShaderProgram(
        zorloadShaderScript(GL_VERTEX_SHADER, kQuadVert), zorloadShaderScript(GL_FRAGMENT_SHADER, kStripes));
    EXPECT_EQ(glGetAttribLocation(program, "vertex"), 0);
    EXPECT_EQ(glGetAttribLocation(program, "texCoord"), 1);
    log.take();
    engine.CreateQuad();
    const GLuint old = engine.quadvbo;
    engine.CreateQuad();
    EXPECT_EQ(
        log.take(),
        (std::vector<std::string>{"I CreateQuad", "I CreateQuad", "I glDelete quadvbo = " + std::to_string(old)}));

    glViewport(0, 0, kSide, kSide);
    glUseProgram(program);
    engine.DrawQuad();
    const auto pixels = readPixels();
    for (int y = 0; y < kSide; ++y) {
        for (int x = 0; x < kSide; ++x) {
            const Rgba& p = pixels[static_cast<std::size_t>(y * kSide + x)];
            ASSERT_NEAR(p[0], (x + 0.5) / kSide * 255, 1.0);
            ASSERT_NEAR(p[1], (y + 0.5) / kSide * 255, 1.0);
        }
    }
    EXPECT_EQ(binding(GL_ARRAY_BUFFER_BINDING), static_cast<int>(engine.quadvbo));
    GLint enabled = -1;
    glGetVertexAttribiv(0, GL_VERTEX_ATTRIB_ARRAY_ENABLED, &enabled);
    EXPECT_EQ(enabled, GL_FALSE);
    glGetVertexAttribiv(1, GL_VERTEX_ATTRIB_ARRAY_ENABLED, &enabled);
    EXPECT_EQ(enabled, GL_TRUE);
}

TEST_F(Toolkit, aPairHasTwoClearedTargetsAndSwapsWhole) {
    Data_ pair = engine.CreateData(20, 10);
    EXPECT_EQ(log.take(), (std::vector<std::string>{"E CreateSurface", "E CreateSurface"}));
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
    EXPECT_NE(pair.Ping.FboHandle, pair.Pong.FboHandle);
    EXPECT_NE(pair.Ping.TextureHandle, pair.Pong.TextureHandle);
    EXPECT_EQ(pair.Pong.Width, 20);
    EXPECT_EQ(pair.Pong.Height, 10);

    const Data_ before = pair;
    engine.SwapSurfaces(&pair);
    EXPECT_EQ(pair.Ping.FboHandle, before.Pong.FboHandle);
    EXPECT_EQ(pair.Pong.TextureHandle, before.Ping.TextureHandle);

    engine.ClearSurface(pair.Ping, 1.0f, 0.0f, 0.2f, 0.0f);
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), static_cast<int>(pair.Ping.FboHandle));
    EXPECT_EQ(readPixels(20, 10), std::vector<Rgba>(200, Rgba{255, 0, 51, 0}));
    glBindFramebuffer(GL_FRAMEBUFFER, pair.Pong.FboHandle);
    EXPECT_EQ(readPixels(20, 10), std::vector<Rgba>(200, Rgba{0, 0, 0, 0}));

    glEnable(GL_BLEND);
    for (const GLenum unit : {GLenum{GL_TEXTURE3}, GLenum{GL_TEXTURE1}}) {
        glActiveTexture(unit);
        glBindTexture(GL_TEXTURE_2D, pair.Ping.TextureHandle);
    }
    engine.ResetState();
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
    EXPECT_FALSE(glIsEnabled(GL_BLEND));
    EXPECT_EQ(binding(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
    glActiveTexture(GL_TEXTURE3);
    EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), 0);
}

TEST_F(Toolkit, anIncompleteFramebufferIsLoggedAndReturnedAllTheSame) {
    const Surface_ surface = engine.CreateSurface(0, 4);
    const auto lines = log.take();
    ASSERT_EQ(lines.size(), 2u);
    EXPECT_EQ(lines[1].find("I FRAMEBUFFER_ERROR - "), 0u) << lines[1];
    EXPECT_NE(surface.FboHandle, 0u);
    glGetError();
}
