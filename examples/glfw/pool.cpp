// pool PHOTO.png: water over a photo, in a window. Each press of the mouse drops a ring and ink.
#include "host/live_water.h"
#include "host/picture.h"
#define GLFW_INCLUDE_NONE
#include <GLFW/glfw3.h>
#include <png.h>

#include <algorithm>

using namespace tidemark;

static Picture photo(const char* path) {
    png_image file = {};
    file.version = PNG_IMAGE_VERSION;
    if (!png_image_begin_read_from_file(&file, path)) return {};
    file.format = PNG_FORMAT_RGBA;
    Picture picture = {static_cast<int>(file.width), static_cast<int>(file.height), {}};
    picture.rgba.resize(PNG_IMAGE_SIZE(file));
    return png_image_finish_read(&file, nullptr, picture.rgba.data(), 0, nullptr) ? picture : Picture{};
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

int main(int argc, char** argv) {
    const Picture ground = photo(argc == 2 ? argv[1] : "photo.png");
    if (!ground.width || !glfwInit()) return 1;
    glfwWindowHint(GLFW_CLIENT_API, GLFW_OPENGL_ES_API);
    glfwWindowHint(GLFW_CONTEXT_CREATION_API, GLFW_EGL_CONTEXT_API);
    glfwWindowHint(GLFW_CONTEXT_VERSION_MAJOR, 2);
    glfwWindowHint(GLFW_CONTEXT_VERSION_MINOR, 0);
    glfwWindowHint(GLFW_RESIZABLE, GLFW_FALSE);
    GLFWwindow* const window = glfwCreateWindow(320, 320, "Pool", nullptr, nullptr);
    if (!window) return 1;
    glfwMakeContextCurrent(window);

    const Pictures pictures = {ground, ground, ground};
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
