// An OpenGL ES 2.0 context without a window, from EGL on Mesa's software driver. Framebuffer 0 is a pbuffer.
#pragma once

#include <memory>
#include <string>

class HeadlessContext {
public:
    // Creates a context with a framebuffer of width x height RGBA8 pixels and makes it current. On failure returns null
    // and stores the reason, with the packages to install, in `error`.
    static std::unique_ptr<HeadlessContext> create(int width, int height, std::string& error);
    ~HeadlessContext();
    HeadlessContext(const HeadlessContext&) = delete;
    HeadlessContext& operator=(const HeadlessContext&) = delete;

private:
    HeadlessContext() = default;
    // EGL handles as void*, so that this header need not include EGL's.
    void* display_ = nullptr;
    void* surface_ = nullptr;
    void* context_ = nullptr;
};
