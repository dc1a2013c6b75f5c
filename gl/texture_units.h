#pragma once

#include <GLES2/gl2.h>

inline void bindTextureUnit(GLenum unit, GLuint texture) {
    glActiveTexture(unit);
    glBindTexture(GL_TEXTURE_2D, texture);
}

// Unbinds the 2-D textures of units 3, 2, 1 and 0, in this order, and leaves unit 0 active.
inline void unbindTextureUnits() {
    for (int unit = 3; unit >= 0; --unit) bindTextureUnit(GL_TEXTURE0 + static_cast<GLenum>(unit), 0);
}
