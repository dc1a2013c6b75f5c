#pragma once

#include <GLES2/gl2.h>
#include <android/bitmap.h>

// Makes a texture from 32-bit RGBA pixels, `info.width` x `info.height`, rows from the top and without padding, and
// stores its name. Null pixels leave its content undefined. It stays bound.
void makePictureTexture(GLuint& texture, const AndroidBitmapInfo& info, const void* pixels);
