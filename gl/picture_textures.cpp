#include "fluid/fluid.h"
#include "gl/deletion.h"
#include "jni/log.h"

namespace {

void replaceTexture(
    const Fluid& engine, GLuint& texture, const char* name, const AndroidBitmapInfo& info, const void* pixels) {
    if (texture) {
        LOG_INFO("glDelete %s = %u", name, texture);
        deleteTexture(engine, texture);
    }
    glGenTextures(1, &texture);
    glBindTexture(GL_TEXTURE_2D, texture);
    glTexImage2D(
        GL_TEXTURE_2D, 0, GL_RGBA, static_cast<GLsizei>(info.width), static_cast<GLsizei>(info.height), 0, GL_RGBA,
        GL_UNSIGNED_BYTE, pixels);
    // Clamped and without mipmaps, so that a picture of any size is complete.
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    glTexParameterf(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
}

}  // namespace

void Fluid::LoadPortraitBGTextures(AndroidBitmapInfo info, void* pixels) {
    LOG_INFO("LoadPortraitBGTextures");
    replaceTexture(*this, portraitBG, "portraitBG", info, pixels);
}

void Fluid::LoadLandscapeBGTextures(AndroidBitmapInfo info, void* pixels) {
    LOG_INFO("LoadLandscapeBGTextures");
    replaceTexture(*this, landscapeBG, "landscapeBG", info, pixels);
}

// By contract without a line of its own.
void Fluid::LoadWaterTextures(AndroidBitmapInfo info, void* pixels) {
    replaceTexture(*this, environment, "environment", info, pixels);
}
