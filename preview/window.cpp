#include "preview/window.h"

#define GLFW_INCLUDE_NONE
#include <GLFW/glfw3.h>

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <fstream>
#include <utility>
#include <vector>

#include "desktop/keep_driver.h"
#include "host/live_water.h"
#include "host/picture.h"
#include "preview/interrupt.h"
#include "preview/new_file.h"
#include "preview/output.h"
#include "preview/scene.h"
#include "preview/touch_script.h"

namespace tidemark {

namespace {

struct Stage {
    LiveWater water;
    bool withInk, raining;
    bool pressed = false;
    std::vector<TouchEvent> touches = {};
};

Stage& stageOf(GLFWwindow* window) {
    return *static_cast<Stage*>(glfwGetWindowUserPointer(window));
}

void touch(GLFWwindow* window, TouchAction action) {
    double x = 0, y = 0;
    int width = 0, height = 0;
    glfwGetCursorPos(window, &x, &y);
    glfwGetWindowSize(window, &width, &height);
    x /= std::max(width, 1);
    y /= std::max(height, 1);
    Stage& stage = stageOf(window);
    stage.water.touch(action, static_cast<float>(x), static_cast<float>(y), 1.0f, glfwGetTime());
    stage.touches.push_back({std::llround(1000.0 * glfwGetTime()), action, {100 * x, true}, {100 * y, true}, 1.0f});
}

void onButton(GLFWwindow* window, int button, int action, int) {
    if (button != GLFW_MOUSE_BUTTON_LEFT) return;
    stageOf(window).pressed = action == GLFW_PRESS;
    touch(window, action == GLFW_PRESS ? TouchAction::down : TouchAction::up);
}

void onMove(GLFWwindow* window, double, double) {
    if (stageOf(window).pressed) touch(window, TouchAction::move);
}

void onKey(GLFWwindow* window, int key, int, int action, int) {
    if (action != GLFW_PRESS) return;
    Stage& stage = stageOf(window);
    if (key == GLFW_KEY_ESCAPE) glfwSetWindowShouldClose(window, GLFW_TRUE);
    if (key == GLFW_KEY_I) stage.water.setInk(stage.withInk = !stage.withInk);
    if (key == GLFW_KEY_R) stage.water.setRain(stage.raining = !stage.raining);
    if (key == GLFW_KEY_C) stage.water.clearInk();
}

// The framebuffer has the window's pixels. The display's density is limited to the quality's, so that the host draws
// exactly these. A minimized window has no pixels.
void onResize(GLFWwindow* window, int width, int height) {
    if (width > 0 && height > 0) stageOf(window).water.setView(width, height, 1.0, glfwGetTime());
}

void onExpose(GLFWwindow* window) {
    stageOf(window).water.redraw();
}

void run(GLFWwindow* window, Stage& stage) {
    glfwSetWindowUserPointer(window, &stage);
    glfwSetMouseButtonCallback(window, onButton);
    glfwSetCursorPosCallback(window, onMove);
    glfwSetKeyCallback(window, onKey);
    glfwSetFramebufferSizeCallback(window, onResize);
    glfwSetWindowRefreshCallback(window, onExpose);
    int width = 0, height = 0;
    glfwGetFramebufferSize(window, &width, &height);
    onResize(window, width, height);
    while (!glfwWindowShouldClose(window) && !interrupted()) {
        switch (stage.water.frame(glfwGetTime())) {
            case LiveWater::Frame::drawn:
                glfwSwapBuffers(window);
                glfwPollEvents();
                break;
            case LiveWater::Frame::waiting:
                glfwWaitEventsTimeout(std::clamp(stage.water.due() - glfwGetTime(), 0.0005, 1.0));
                break;
            case LiveWater::Frame::resting:
                glfwWaitEventsTimeout(0.5);  // so that an interrupt is noticed
                break;
            case LiveWater::Frame::resize:
                stage.water.resized();
                break;
        }
    }
    if (stage.pressed) touch(window, TouchAction::up);
}

// Shifts a script so that it begins shortly before its first touch.
bool saveTouches(
    const PreviewOptions& options, std::vector<TouchEvent> touches, std::string& summary, std::string& error) {
    constexpr std::int64_t kBefore = 200;
    const std::int64_t first = touches.empty() ? 0 : touches.front().timeMs;
    for (TouchEvent& touch : touches) touch.timeMs += kBefore - first;
    const std::string text = writeTouchScript(touches);
    NewFile file;
    if (!file.make(options.record, options.force, error)) return false;
    if (std::ofstream script(file.part()); !(script << text).flush()) {
        error = "cannot write " + options.record + ": " + std::strerror(errno);
        return false;
    }
    summary = "Wrote " + std::to_string(touches.size()) + " events of touches: " + options.record + " (" +
              sizeInWords(text.size()) + ")";
    return file.keep(error);
}

bool fail(const std::string& what, std::string& error) {
    const char* reason = nullptr;
    glfwGetError(&reason);
    error = what + (reason ? std::string(": ") + reason : "");
    return false;
}

}  // namespace

bool runWindow(PreviewOptions options, std::string& summary, std::string& error) {
    if (!options.record.empty() && !mayWrite(options.record, options.force, error)) return false;
    const std::optional<Look> look = chooseLook(options, error);
    if (!look) return false;
    if (!glfwInit()) return fail("no screen for a window", error);
    struct Ended {
        ~Ended() { glfwTerminate(); }
    } ended;
    GLFWmonitor* const screen = options.fullscreen ? glfwGetPrimaryMonitor() : nullptr;
    if (screen) {
        const GLFWvidmode* const mode = glfwGetVideoMode(screen);
        options.size = {mode->width, mode->height};
    }
    std::optional<Pictures> pictures = choosePictures(options, error);
    if (!pictures) return false;
    const std::pair<int, int> hints[] = {
        {GLFW_CLIENT_API, GLFW_OPENGL_ES_API},
        {GLFW_CONTEXT_CREATION_API, GLFW_EGL_CONTEXT_API},
        {GLFW_CONTEXT_VERSION_MAJOR, 2},
        {GLFW_CONTEXT_VERSION_MINOR, 0},
        {GLFW_ALPHA_BITS, 0},
        {GLFW_DEPTH_BITS, 0},
        {GLFW_STENCIL_BITS, 0}};
    for (const auto& [hint, value] : hints) glfwWindowHint(hint, value);
    GLFWwindow* const window = glfwCreateWindow(options.size.width, options.size.height, "Tidemark", screen, nullptr);
    if (!window) return fail("cannot open a window", error);
    glfwMakeContextCurrent(window);
    glfwSwapInterval(1);
    keepDriverLoaded();
    fitToDriver(options.light, pictures->light);

    // The library's ink uses this generator.
    srand48(static_cast<long>(options.seed));
    Stage stage{LiveWater(sourceOf(*pictures, *look), options.seed), options.withInk, options.rainFrom.has_value()};
    stage.water.setQuality(Quality::high);
    stage.water.setLook(*look);
    stage.water.picturesChanged(kAllPictures);
    stage.water.setInk(stage.withInk);
    stage.water.setRain(stage.raining);
    recordInterrupts();
    run(window, stage);
    return options.record.empty() || saveTouches(options, std::move(stage.touches), summary, error);
}

}  // namespace tidemark
