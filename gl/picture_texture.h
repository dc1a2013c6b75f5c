#pragma once

#include <GLES2/gl2.h>
#include <android/bitmap.h>

// Creates a texture of `info.width` x `info.height` RGBA8 texels and stores its name. `pixels` starts with the top row
// and has no padding; null leaves the content undefined. The texture stays bound.
void makePictureTexture(GLuint& texture, const AndroidBitmapInfo& info, const void* pixels);
