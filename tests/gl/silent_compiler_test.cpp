#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "gl/shader_program.h"
#include "probes/counting_gl.h"
#include "tests/support/log_recorder.h"

using Lines = std::vector<std::string>;

TEST(SilentCompiler, logsAFailureOnlyIfTheDriverReportsAnInfoLog) {
    LogRecorder log;
    GlCompiler::succeeds = false;
    for (const int length : {0, 1, 40}) {  // The driver reports a length and never writes a text.
        GlCompiler::logLength = length;
        EXPECT_EQ(zorloadShaderScript(GL_VERTEX_SHADER, ""), 0u);
        EXPECT_EQ(zorCreateShaderProgram(1, 2), 0u);
        Lines expected = {"E zorloadShaderScript", "I zorCreateShaderProgram"};
        if (length > 1) {
            expected = {
                expected[0], "E Could not compile shader 35633:\n\n", expected[1], "E Could not link program:\n\n"};
        }
        EXPECT_EQ(log.take(), expected) << length;
    }
    GlCompiler::succeeds = true;
    GlCompiler::logLength = 0;
}
