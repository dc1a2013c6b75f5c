// Sets a uniform of the program in use. By contract its location is looked up by name on every call. GL ignores a name
// that the program does not declare.
#pragma once

#include <GLES2/gl2.h>

inline void setUniform(GLuint program, const char* name, float x) {
    glUniform1f(glGetUniformLocation(program, name), x);
}

inline void setUniform(GLuint program, const char* name, float x, float y) {
    glUniform2f(glGetUniformLocation(program, name), x, y);
}

inline void setUniform(GLuint program, const char* name, float x, float y, float z) {
    glUniform3f(glGetUniformLocation(program, name), x, y, z);
}

inline void setUniform(GLuint program, const char* name, int value) {
    glUniform1i(glGetUniformLocation(program, name), value);
}
