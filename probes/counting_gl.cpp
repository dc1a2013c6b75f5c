#include "probes/counting_gl.h"

#include <GLES2/gl2.h>

#include <algorithm>
#include <cstdlib>
#include <cstring>

namespace {

struct Counter {
    explicit Counter(const char* function) : name(function), next(first) { first = this; }
    const char* name;
    int calls = 0;
    Counter* next;
    static inline Counter* first = nullptr;
};

std::size_t uploaded = 0;
GLuint lastName = 0;
GLuint arrayBuffer = 0;
GLuint elementBuffer = 0;

void makeNames(GLsizei count, GLuint* names) {
    for (GLsizei i = 0; i < count; ++i) names[i] = ++lastName;
}

// Also reads the first and last byte, so that a sanitizer detects a size beyond the end of the block.
void countUpload(const void* data, GLsizeiptr bytes) {
    if (!data || bytes <= 0) return;
    const auto* const block = static_cast<const volatile unsigned char*>(data);
    static_cast<void>(block[0]);
    static_cast<void>(block[bytes - 1]);
    uploaded += static_cast<std::size_t>(bytes);
}

// Without a bound buffer a driver takes the offset as an address.
void requireBuffer(GLuint buffer, const void* offset) {
    if (!buffer && !offset) std::abort();
}

GLint answer(GLenum query) {
    return query == GL_INFO_LOG_LENGTH ? GlCompiler::logLength : GlCompiler::succeeds;
}

}  // namespace

GlUse takeGlUse() {
    GlUse use;
    use.bytes = uploaded;
    uploaded = 0;
    for (Counter* counter = Counter::first; counter; counter = counter->next) {
        if (counter->calls) use.calls[counter->name] = counter->calls;
        counter->calls = 0;
    }
    return use;
}

// COUNT defines a function that counts its calls and runs `action`; ANSWER one that also returns a value.
#define COUNT(name, parameters, action)          \
    void GL_APIENTRY name parameters {           \
        static Counter counter = Counter(#name); \
        ++counter.calls;                         \
        action;                                  \
    }
#define ANSWER(type, name, parameters, answer)   \
    type GL_APIENTRY name parameters {           \
        static Counter counter = Counter(#name); \
        ++counter.calls;                         \
        return answer;                           \
    }

extern "C" {

COUNT(glActiveTexture, (GLenum), )
COUNT(glAttachShader, (GLuint, GLuint), )
COUNT(glBindAttribLocation, (GLuint, GLuint, const GLchar*), )
COUNT(glBindBuffer, (GLenum target, GLuint buffer), (target == GL_ARRAY_BUFFER ? arrayBuffer : elementBuffer) = buffer)
COUNT(glBindFramebuffer, (GLenum, GLuint), )
COUNT(glBindTexture, (GLenum, GLuint), )
COUNT(glBlendFunc, (GLenum, GLenum), )
COUNT(glBufferData, (GLenum, GLsizeiptr size, const void* data, GLenum), countUpload(data, size))
ANSWER(GLenum, glCheckFramebufferStatus, (GLenum), GL_FRAMEBUFFER_COMPLETE)
COUNT(glClear, (GLbitfield), )
COUNT(glClearColor, (GLfloat, GLfloat, GLfloat, GLfloat), )
COUNT(glCompileShader, (GLuint), )
ANSWER(GLuint, glCreateProgram, (), ++lastName)
ANSWER(GLuint, glCreateShader, (GLenum), ++lastName)
COUNT(glDeleteBuffers, (GLsizei, const GLuint*), )
COUNT(glDeleteFramebuffers, (GLsizei, const GLuint*), )
COUNT(glDeleteProgram, (GLuint), )
COUNT(glDeleteShader, (GLuint), )
COUNT(glDeleteTextures, (GLsizei, const GLuint*), )
COUNT(glDisable, (GLenum), )
COUNT(glDisableVertexAttribArray, (GLuint), )
COUNT(glDrawArrays, (GLenum, GLint, GLsizei), )
COUNT(glDrawElements, (GLenum, GLsizei, GLenum, const void* offset), requireBuffer(elementBuffer, offset))
COUNT(glEnableVertexAttribArray, (GLuint), )
COUNT(glFramebufferTexture2D, (GLenum, GLenum, GLenum, GLuint, GLint), )
COUNT(glGenBuffers, (GLsizei count, GLuint* names), makeNames(count, names))
COUNT(glGenFramebuffers, (GLsizei count, GLuint* names), makeNames(count, names))
COUNT(glGenTextures, (GLsizei count, GLuint* names), makeNames(count, names))
// The length of its name is a distinct location for each attribute of a program.
ANSWER(GLint, glGetAttribLocation, (GLuint, const GLchar* name), static_cast<GLint>(std::strlen(name)))
COUNT(glGetProgramInfoLog, (GLuint, GLsizei, GLsizei*, GLchar*), )
COUNT(glGetProgramiv, (GLuint, GLenum query, GLint* value), *value = answer(query))
COUNT(glGetShaderInfoLog, (GLuint, GLsizei, GLsizei*, GLchar*), )
COUNT(glGetShaderiv, (GLuint, GLenum query, GLint* value), *value = answer(query))
ANSWER(GLint, glGetUniformLocation, (GLuint, const GLchar* name), static_cast<GLint>(std::strlen(name)))
COUNT(glLinkProgram, (GLuint), )
COUNT(glShaderSource, (GLuint, GLsizei, const GLchar* const*, const GLint*), )
COUNT(
    glTexImage2D, (GLenum, GLint, GLint, GLsizei width, GLsizei height, GLint, GLenum, GLenum, const void* pixels),
    if (pixels) countUpload(pixels, GLsizeiptr{4} * std::max(width, 0) * std::max(height, 0)))
COUNT(glTexParameterf, (GLenum, GLenum, GLfloat), )
COUNT(glTexParameteri, (GLenum, GLenum, GLint), )
COUNT(glUniform1f, (GLint, GLfloat), )
COUNT(glUniform1i, (GLint, GLint), )
COUNT(glUniform2f, (GLint, GLfloat, GLfloat), )
COUNT(glUniform3f, (GLint, GLfloat, GLfloat, GLfloat), )
COUNT(glUniformMatrix4fv, (GLint, GLsizei, GLboolean, const GLfloat*), )
COUNT(glUseProgram, (GLuint), )
COUNT(
    glVertexAttribPointer, (GLuint, GLint, GLenum, GLboolean, GLsizei, const void* offset),
    requireBuffer(arrayBuffer, offset))
COUNT(glViewport, (GLint, GLint, GLsizei, GLsizei), )

}  // extern "C"
