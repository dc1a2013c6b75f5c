#pragma once

#include <GLES2/gl2.h>

// Draws a quad over the whole target with the program in use. Uploads the corners into `buffer`: attribute 0 is the
// position, attribute 1 the texture coordinates from (0, 0) at the bottom left to (1, 1). Leaves `buffer` bound and
// attribute 1 enabled.
void drawQuad(GLuint buffer);
