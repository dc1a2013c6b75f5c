// Compiles shaders and links programs. On failure the functions log the driver's info log and return 0.
#pragma once

#include <GLES2/gl2.h>

// Compiles a NUL-terminated source.
GLuint zorloadShaderScript(GLenum type, const char* source);

// Links a program with attribute "vertex" at location 0 and "texCoord" at 1. The caller keeps ownership of the shaders.
GLuint zorCreateShaderProgram(GLuint vertexShader, GLuint fragmentShader);
