// Shaders and programs. Failures are logged with the driver's own words and give 0.
#pragma once

#include <GLES2/gl2.h>

// A compiled shader of `type` from a NUL-terminated source, or 0.
GLuint zorloadShaderScript(GLenum type, const char* source);

// A linked program with attribute "vertex" at location 0 and "texCoord" at 1, or 0. The shaders stay the caller's.
GLuint zorCreateShaderProgram(GLuint vertexShader, GLuint fragmentShader);
