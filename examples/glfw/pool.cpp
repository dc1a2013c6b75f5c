// Water over a tiled pool, in a window: each press of the mouse drops a ring and ink.
#include "host/live_water.h"
#include "host/picture.h"
#define GLFW_INCLUDE_NONE
#include <GLFW/glfw3.h>

#include <algorithm>

using namespace tidemark;

static Picture tiles(int width, int height) {
    Picture picture{width, height, {}};
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const bool joint = x % 40 < 2 || y % 40 < 2;
            for (int channel : {joint ? 200 : 40, joint ? 220 : 140, joint ? 220 : 170, 255})
                picture.rgba.push_back(static_cast<std::uint8_t>(channel));
        }
    }
    return picture;
}

static void onButton(GLFWwindow* window, int, int action, int) {
    double x, y;
    int width, height;
    glfwGetCursorPos(window, &x, &y);
    glfwGetWindowSize(window, &width, &height);
    static_cast<LiveWater*>(glfwGetWindowUserPointer(window))
        ->touch(
            action == GLFW_PRESS ? TouchAction::down : TouchAction::up, static_cast<float>(x / width),
            static_cast<float>(y / height), 1.0f, glfwGetTime());
}

int main() {
    if (!glfwInit()) return 1;
    glfwWindowHint(GLFW_CLIENT_API, GLFW_OPENGL_ES_API);
    glfwWindowHint(GLFW_CONTEXT_CREATION_API, GLFW_EGL_CONTEXT_API);
    glfwWindowHint(GLFW_CONTEXT_VERSION_MAJOR, 2);
    glfwWindowHint(GLFW_CONTEXT_VERSION_MINOR, 0);
    glfwWindowHint(GLFW_RESIZABLE, GLFW_FALSE);
    GLFWwindow* const window = glfwCreateWindow(320, 320, "Pool", nullptr, nullptr);
    if (!window) return 1;
    glfwMakeContextCurrent(window);

    const Pictures pictures = {tiles(320, 320), tiles(320, 320), tiles(64, 64)};
    LiveWater water(sourceOf(pictures), 1);
    int width, height;
    glfwGetFramebufferSize(window, &width, &height);
    water.setView(width, height, 1.0, glfwGetTime());
    water.setQuality(Quality::high);
    water.picturesChanged(kAllPictures);
    water.setInk(true);
    glfwSetWindowUserPointer(window, &water);
    glfwSetMouseButtonCallback(window, onButton);
    glfwSetWindowRefreshCallback(
        window, [](GLFWwindow* exposed) { static_cast<LiveWater*>(glfwGetWindowUserPointer(exposed))->redraw(); });
    while (!glfwWindowShouldClose(window)) {
        const LiveWater::Frame frame = water.frame(glfwGetTime());
        if (frame == LiveWater::Frame::resize) water.resized();
        if (frame == LiveWater::Frame::drawn) glfwSwapBuffers(window);
        // Until the next frame is due or something happens; a frame that was drawn needs no wait.
        glfwWaitEventsTimeout(std::clamp(water.due() - glfwGetTime(), 0.0005, 0.5));
    }
    glfwTerminate();
}
