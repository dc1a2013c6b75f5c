#include "fluid/fluid.h"
#include "gl/shader_program.h"
#include "jni/log.h"
#include "shaders.h"

namespace {

struct Program {
    GLuint& program;
    GLuint& vertexShader;
    GLuint& fragmentShader;
};

// Deletes what an earlier set-up built, named in the log as `name`, and builds the program anew.
void rebuild(Program made, const char* name, const char* announcement, const char* vertexSource,
             const char* fragmentSource) {
    if (made.program) {
        LOG_INFO("glDelete %s = %u", name, made.program);
        glDeleteShader(made.vertexShader);
        glDeleteShader(made.fragmentShader);
        glDeleteProgram(made.program);
    }
    LOG_INFO("%s zorCreateShaderProgram()", announcement);
    made.vertexShader = zorloadShaderScript(GL_VERTEX_SHADER, vertexSource);
    made.fragmentShader = zorloadShaderScript(GL_FRAGMENT_SHADER, fragmentSource);
    made.program = zorCreateShaderProgram(made.vertexShader, made.fragmentShader);
}

void renewBuffer(GLuint& buffer, const char* name) {
    if (buffer) {
        LOG_INFO("glDelete %s = %u", name, buffer);
        glDeleteBuffers(1, &buffer);
    }
    glGenBuffers(1, &buffer);
}

}  // namespace

void Fluid::InitializeSetting(int width, int height, bool) {
    LOG_INFO("InitializeSetting");
    InkColor = {1.0f, 1.0f, 1.0f};
    ScreenWidth = width;
    ScreenHeight = height;
    renewBuffer(v_buf, "v_buf");
    renewBuffer(h_buf, "h_buf");
    renewBuffer(i_buf, "i_buf");
}

void Fluid::InitializeGPU(bool) {
    LOG_INFO("InitializeGPU");
    rebuild({ripple_program, ripple_vertexShader, ripple_fragmentShader}, "ripple_program", "ripple_vertextShader",
            kWaterVert, kWaterPlainFrag);
}
