// A test fixture with a new OpenGL ES 2.0 context of Mesa's software driver. Fails on a GL error that is left at the
// end.
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

    // Replaces the context; the objects of the previous one are lost.
    void renewContext(int width = kSide, int height = kSide) {
        loseContext();
        // Mesa would otherwise create a newer context, which accepts more.
        setenv("MESA_GLES_VERSION_OVERRIDE", "2.0", 1);
        std::string error;
        context_ = HeadlessContext::create(width, height, error);
        ASSERT_TRUE(context_) << error;
    }

    // Returns rows from the bottom.
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
    // True after losing a context with programs: the next set-up deletes names that the new context does not have.
    bool staleNames_ = false;
};
