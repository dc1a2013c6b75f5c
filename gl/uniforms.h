// Sets one uniform of the program in use by its name. By contract names are looked up at every use; one that the
// program does not declare is ignored by GL.
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
