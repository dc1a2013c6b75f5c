#include "gl/picture_texture.h"

void makePictureTexture(GLuint& texture, const AndroidBitmapInfo& info, const void* pixels) {
    glGenTextures(1, &texture);
    glBindTexture(GL_TEXTURE_2D, texture);
    glTexImage2D(
        GL_TEXTURE_2D, 0, GL_RGBA, static_cast<GLsizei>(info.width), static_cast<GLsizei>(info.height), 0, GL_RGBA,
        GL_UNSIGNED_BYTE, pixels);
    // OpenGL ES 2.0 samples a texture of any size only with clamping and without mipmaps.
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
}
