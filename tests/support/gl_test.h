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

#include "platform/headless_context.h"
#include "tests/support/log_recorder.h"

using Rgba = std::array<std::uint8_t, 4>;

class GlTest : public testing::Test {
protected:
    static constexpr int kSide = 64;  // of framebuffer 0

    void SetUp() override { renewContext(); }
    void TearDown() override {
        if (!context_) return;
        const GLenum error = glGetError();
        // A set-up in a new context deletes names of the lost one, which the new one does not know.
        EXPECT_TRUE(error == GL_NO_ERROR || (renewals_ > 1 && error == GL_INVALID_VALUE)) << "GL error " << error;
    }

    // Loses everything that the last context held.
    void renewContext(int width = kSide, int height = kSide) {
        // An OpenGL ES 2.0 driver, so that the use of anything newer shows.
        setenv("MESA_GLES_VERSION_OVERRIDE", "2.0", 1);
        std::string error;
        context_.reset();
        context_ = HeadlessContext::create(width, height, error);
        ASSERT_TRUE(context_) << error;
        ++renewals_;
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

    LogRecorder log;

private:
    std::unique_ptr<HeadlessContext> context_;
    int renewals_ = 0;
};
