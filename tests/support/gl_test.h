// A test with a fresh OpenGL ES 2.0 context of Mesa's software driver, and no GL error at its end.
#pragma once

#include <GLES2/gl2.h>
#include <gtest/gtest.h>

#include <array>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <string>
#include <vector>

#include "desktop/headless_context.h"
#include "tests/support/log_recorder.h"

using Rgba = std::array<std::uint8_t, 4>;

class GlTest : public testing::Test {
protected:
    static constexpr int kSide = 64;  // of framebuffer 0

    void SetUp() override { renewContext(); }
    void TearDown() override { loseContext(); }

    // Loses everything that the last context held.
    void renewContext(int width = kSide, int height = kSide) {
        loseContext();
        // An OpenGL ES 2.0 driver, so that the use of anything newer shows.
        setenv("MESA_GLES_VERSION_OVERRIDE", "2.0", 1);
        std::string error;
        context_ = HeadlessContext::create(width, height, error);
        ASSERT_TRUE(context_) << error;
    }

    // Rows from the bottom.
    static std::vector<Rgba> readPixels(int width = kSide, int height = kSide) {
        std::vector<Rgba> pixels(static_cast<std::size_t>(width) * static_cast<std::size_t>(height));
        glReadPixels(0, 0, width, height, GL_RGBA, GL_UNSIGNED_BYTE, pixels.data());
        return pixels;
    }

    static int binding(GLenum name) {
        GLint value = -1;
        glGetIntegerv(name, &value);
        return value;
    }

    static std::array<int, 4> viewport() {
        std::array<int, 4> box = {};
        glGetIntegerv(GL_VIEWPORT, box.data());
        return box;
    }

    LogRecorder log;

private:
    void loseContext() {
        if (!context_) return;
        const GLenum error = glGetError();
        EXPECT_TRUE(error == GL_NO_ERROR || (staleNames_ && error == GL_INVALID_VALUE)) << "GL error " << error;
        for (GLuint name = 1; name < 100; ++name) staleNames_ = staleNames_ || glIsProgram(name);
        context_.reset();
    }

    std::unique_ptr<HeadlessContext> context_;
    // A context with programs was lost: the next set-up deletes names that the new one does not know.
    bool staleNames_ = false;
};
