// An OpenGL ES 2.0 context without a window: EGL on Mesa's software driver, with a pbuffer as framebuffer 0.
#pragma once

#include <memory>
#include <string>

class HeadlessContext {
public:
    // Makes a context with a framebuffer of width x height RGBA8 pixels and makes it current. On failure
    // returns null and says why, and what to install, in `error`.
    static std::unique_ptr<HeadlessContext> create(int width, int height, std::string& error);
    ~HeadlessContext();
    HeadlessContext(const HeadlessContext&) = delete;
    HeadlessContext& operator=(const HeadlessContext&) = delete;

private:
    HeadlessContext() = default;
    // EGL's handles are plain pointers; kept so here to spare the users of this header EGL's.
    void* display_ = nullptr;
    void* surface_ = nullptr;
    void* context_ = nullptr;
};
