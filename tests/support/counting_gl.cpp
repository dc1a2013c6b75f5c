#include "tests/support/counting_gl.h"

#include <GLES2/gl2.h>

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

// Reads both ends of what is handed over, as a driver would: a sanitizer then sees a size that the block does not have.
void take(const void* data, std::size_t bytes) {
    if (!data || !bytes) return;
    const auto* const block = static_cast<const volatile unsigned char*>(data);
    static_cast<void>(block[0]);
    static_cast<void>(block[bytes - 1]);
    uploaded += bytes;
}

// Without a buffer the offset is an address, and a driver reads there.
void requireBuffer(GLuint buffer, const void* offset) {
    if (!buffer && !offset) std::abort();
}

// Compiled and linked, with nothing to say about it.
GLint answer(GLenum query) {
    return query == GL_INFO_LOG_LENGTH ? 0 : GL_TRUE;
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

#define COUNT_THIS_CALL                         \
    static Counter counter = Counter(__func__); \
    ++counter.calls

extern "C" {

void GL_APIENTRY glActiveTexture(GLenum) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glAttachShader(GLuint, GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glBindAttribLocation(GLuint, GLuint, const GLchar*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glBindBuffer(GLenum target, GLuint buffer) {
    COUNT_THIS_CALL;
    (target == GL_ARRAY_BUFFER ? arrayBuffer : elementBuffer) = buffer;
}
void GL_APIENTRY glBindFramebuffer(GLenum, GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glBindTexture(GLenum, GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glBlendFunc(GLenum, GLenum) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glBufferData(GLenum, GLsizeiptr size, const void* data, GLenum) {
    COUNT_THIS_CALL;
    if (size > 0) take(data, static_cast<std::size_t>(size));
}
GLenum GL_APIENTRY glCheckFramebufferStatus(GLenum) {
    COUNT_THIS_CALL;
    return GL_FRAMEBUFFER_COMPLETE;
}
void GL_APIENTRY glClear(GLbitfield) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glClearColor(GLfloat, GLfloat, GLfloat, GLfloat) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glCompileShader(GLuint) {
    COUNT_THIS_CALL;
}
GLuint GL_APIENTRY glCreateProgram() {
    COUNT_THIS_CALL;
    return ++lastName;
}
GLuint GL_APIENTRY glCreateShader(GLenum) {
    COUNT_THIS_CALL;
    return ++lastName;
}
void GL_APIENTRY glDeleteBuffers(GLsizei, const GLuint*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDeleteFramebuffers(GLsizei, const GLuint*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDeleteProgram(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDeleteShader(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDeleteTextures(GLsizei, const GLuint*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDisable(GLenum) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDisableVertexAttribArray(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDrawArrays(GLenum, GLint, GLsizei) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glDrawElements(GLenum, GLsizei, GLenum, const void* offset) {
    COUNT_THIS_CALL;
    requireBuffer(elementBuffer, offset);
}
void GL_APIENTRY glEnableVertexAttribArray(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glFramebufferTexture2D(GLenum, GLenum, GLenum, GLuint, GLint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glGenBuffers(GLsizei count, GLuint* names) {
    COUNT_THIS_CALL;
    makeNames(count, names);
}
void GL_APIENTRY glGenFramebuffers(GLsizei count, GLuint* names) {
    COUNT_THIS_CALL;
    makeNames(count, names);
}
void GL_APIENTRY glGenTextures(GLsizei count, GLuint* names) {
    COUNT_THIS_CALL;
    makeNames(count, names);
}
// The length tells the names of one program's attributes apart, and that is all that a location is for.
GLint GL_APIENTRY glGetAttribLocation(GLuint, const GLchar* name) {
    COUNT_THIS_CALL;
    return static_cast<GLint>(std::strlen(name));
}
void GL_APIENTRY glGetProgramInfoLog(GLuint, GLsizei, GLsizei*, GLchar*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glGetProgramiv(GLuint, GLenum query, GLint* value) {
    COUNT_THIS_CALL;
    *value = answer(query);
}
void GL_APIENTRY glGetShaderInfoLog(GLuint, GLsizei, GLsizei*, GLchar*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glGetShaderiv(GLuint, GLenum query, GLint* value) {
    COUNT_THIS_CALL;
    *value = answer(query);
}
GLint GL_APIENTRY glGetUniformLocation(GLuint, const GLchar* name) {
    COUNT_THIS_CALL;
    return static_cast<GLint>(std::strlen(name));
}
void GL_APIENTRY glLinkProgram(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glShaderSource(GLuint, GLsizei, const GLchar* const*, const GLint*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY
glTexImage2D(GLenum, GLint, GLint, GLsizei width, GLsizei height, GLint, GLenum, GLenum, const void* pixels) {
    COUNT_THIS_CALL;
    if (width > 0 && height > 0) take(pixels, 4 * static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
}
void GL_APIENTRY glTexParameterf(GLenum, GLenum, GLfloat) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glTexParameteri(GLenum, GLenum, GLint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUniform1f(GLint, GLfloat) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUniform1i(GLint, GLint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUniform2f(GLint, GLfloat, GLfloat) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUniform3f(GLint, GLfloat, GLfloat, GLfloat) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUniformMatrix4fv(GLint, GLsizei, GLboolean, const GLfloat*) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glUseProgram(GLuint) {
    COUNT_THIS_CALL;
}
void GL_APIENTRY glVertexAttribPointer(GLuint, GLint, GLenum, GLboolean, GLsizei, const void* offset) {
    COUNT_THIS_CALL;
    requireBuffer(arrayBuffer, offset);
}
void GL_APIENTRY glViewport(GLint, GLint, GLsizei, GLsizei) {
    COUNT_THIS_CALL;
}

}  // extern "C"
