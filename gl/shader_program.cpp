#include "gl/shader_program.h"

#include <cstddef>
#include <cstdlib>
#include <memory>

#include "base/log.h"

namespace {

struct Free {
    void operator()(char* text) const { std::free(text); }
};

// Reads an info log of at most `length` bytes with `get`. Returns null if it is empty or the allocation fails: the text
// is only logged.
template <class Get>
std::unique_ptr<char, Free> readInfoLog(GLint length, Get get) {
    if (length <= 1) return nullptr;
    std::unique_ptr<char, Free> text(static_cast<char*>(std::malloc(static_cast<std::size_t>(length))));
    if (!text) return nullptr;
    *text = '\0';  // some drivers report a length and write nothing
    get(length, text.get());
    return text;
}

}  // namespace

GLuint zorloadShaderScript(GLenum type, const char* source) {
    LOG_ERROR("zorloadShaderScript");  // By contract at error priority.
    const GLuint shader = glCreateShader(type);
    if (!shader) return 0;
    glShaderSource(shader, 1, &source, nullptr);
    glCompileShader(shader);
    GLint compiled = GL_FALSE;
    glGetShaderiv(shader, GL_COMPILE_STATUS, &compiled);
    if (compiled) return shader;

    GLint length = 0;
    glGetShaderiv(shader, GL_INFO_LOG_LENGTH, &length);
    const auto text =
        readInfoLog(length, [shader](GLint size, char* to) { glGetShaderInfoLog(shader, size, nullptr, to); });
    // By contract the number is the shader's type, not its name.
    if (text) LOG_ERROR("Could not compile shader %d:\n%s\n", static_cast<int>(type), text.get());
    glDeleteShader(shader);
    return 0;
}

GLuint zorCreateShaderProgram(GLuint vertexShader, GLuint fragmentShader) {
    LOG_INFO("zorCreateShaderProgram");
    if (!fragmentShader || !vertexShader) return 0;
    const GLuint program = glCreateProgram();
    if (!program) return 0;
    glAttachShader(program, vertexShader);
    glAttachShader(program, fragmentShader);
    // By contract also for the water's program, which declares neither attribute.
    glBindAttribLocation(program, 0, "vertex");
    glBindAttribLocation(program, 1, "texCoord");
    glLinkProgram(program);
    GLint linked = GL_FALSE;
    glGetProgramiv(program, GL_LINK_STATUS, &linked);
    if (linked) return program;

    GLint length = 0;
    glGetProgramiv(program, GL_INFO_LOG_LENGTH, &length);
    const auto text =
        readInfoLog(length, [program](GLint size, char* to) { glGetProgramInfoLog(program, size, nullptr, to); });
    if (text) LOG_ERROR("Could not link program:\n%s\n", text.get());
    glDeleteProgram(program);
    return 0;
}
