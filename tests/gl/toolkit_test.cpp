#include "gl/shader_program.h"
#include "gl/targets.h"
#include "shaders/shaders.h"
#include "tests/support/gl_test.h"

using Toolkit = GlTest;

TEST_F(Toolkit, compileAndLinkFailuresAreLoggedAndReturnZero) {
    EXPECT_EQ(zorloadShaderScript(GL_FRAGMENT_SHADER, "void main() { nonsense }"), 0u);
    EXPECT_EQ(log.take().at(1).find("E Could not compile shader 35632:\n"), 0u);
    for (GLuint name = 1; name < 9; ++name) EXPECT_FALSE(glIsShader(name)) << "a failed shader is deleted";
    EXPECT_EQ(zorloadShaderScript(GL_TEXTURE_2D, kQuadVert), 0u) << "no such kind of shader";
    EXPECT_EQ(glGetError(), static_cast<GLenum>(GL_INVALID_ENUM));

    const GLuint vertex = zorloadShaderScript(GL_VERTEX_SHADER, kQuadVert);
    const GLuint fragment = zorloadShaderScript(
        GL_FRAGMENT_SHADER,
        "precision mediump float; varying vec3 missing; void main() { gl_FragColor = missing.xyzz; }");
    log.take();
    EXPECT_EQ(zorCreateShaderProgram(vertex, fragment), 0u);
    EXPECT_EQ(log.take().at(1).find("E Could not link program:\n"), 0u);
    for (GLuint name = 1; name < 9; ++name) EXPECT_FALSE(glIsProgram(name)) << "a failed program is deleted";
    EXPECT_TRUE(glIsShader(vertex) && glIsShader(fragment)) << "the caller keeps the shaders";
    EXPECT_EQ(zorCreateShaderProgram(vertex, 0), 0u);
    EXPECT_EQ(zorCreateShaderProgram(0, fragment), 0u);
}

TEST_F(Toolkit, incompleteTargetIsLoggedAndReturned) {
    EXPECT_NE(createSurface(0, 4).FboHandle, 0u);
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
    EXPECT_EQ(log.take().at(1).find("I FRAMEBUFFER_ERROR - "), 0u);
    glGetError();
}
