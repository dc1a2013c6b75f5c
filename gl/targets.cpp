#include "gl/targets.h"

#include "base/log.h"
#include "gl/texture_units.h"

Surface_ createSurface(int width, int height) {
    LOG_ERROR("CreateSurface");  // By contract at error priority.
    Surface_ surface;
    surface.Width = width;
    surface.Height = height;
    glGenFramebuffers(1, &surface.FboHandle);
    glBindFramebuffer(GL_FRAMEBUFFER, surface.FboHandle);
    glGenTextures(1, &surface.TextureHandle);
    glBindTexture(GL_TEXTURE_2D, surface.TextureHandle);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_S, GL_CLAMP_TO_EDGE);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_WRAP_T, GL_CLAMP_TO_EDGE);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MIN_FILTER, GL_LINEAR);
    glTexParameteri(GL_TEXTURE_2D, GL_TEXTURE_MAG_FILTER, GL_LINEAR);
    if (width <= kLargestSide && height <= kLargestSide) {
        glTexImage2D(GL_TEXTURE_2D, 0, GL_RGBA, width, height, 0, GL_RGBA, GL_UNSIGNED_BYTE, nullptr);
    }
    glFramebufferTexture2D(GL_FRAMEBUFFER, GL_COLOR_ATTACHMENT0, GL_TEXTURE_2D, surface.TextureHandle, 0);
    const GLenum status = glCheckFramebufferStatus(GL_FRAMEBUFFER);
    // By contract at info priority.
    if (status != GL_FRAMEBUFFER_COMPLETE) LOG_INFO("FRAMEBUFFER_ERROR - %d", static_cast<int>(status));
    glClearColor(0.0f, 0.0f, 0.0f, 0.0f);
    glClear(GL_COLOR_BUFFER_BIT);
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
    return surface;
}

void clearSurface(const Surface_& surface, float red, float green, float blue, float alpha) {
    glBindFramebuffer(GL_FRAMEBUFFER, surface.FboHandle);
    glClearColor(red, green, blue, alpha);
    glClear(GL_COLOR_BUFFER_BIT);
}

void resetState() {
    unbindTextureUnits();
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
    glDisable(GL_BLEND);
}
