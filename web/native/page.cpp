// What the page calls: the water of one canvas. web/src/water.ts gives it types.
#include <GLES2/gl2.h>
#include <emscripten.h>
#include <emscripten/html5.h>

#include <cstdlib>
#include <optional>
#include <utility>

#include "host/live_water.h"
#include "platform/log_filter.h"

// The page fills the look as an array of numbers in the order of look.properties.
static_assert(sizeof(int) == 4 && sizeof(float) == 4 && alignof(Look) == 4);

namespace {

Look look;
std::optional<LiveWater> water;
Pictures pictures;  // being filled

}  // namespace

// The names of objects that were lost with their context must not reach the new one.
// clang-format off
EM_JS(void, forgetObjects, (), {
    for (const table of [GL.buffers, GL.framebuffers, GL.programs, GL.shaders, GL.textures]) table.fill(null);
});
// clang-format on

extern "C" {

// Needs an element <canvas id="water">. False where the browser has no WebGL.
EMSCRIPTEN_KEEPALIVE bool openCanvas(std::uint32_t seed) {
    quietenLog();
    EmscriptenWebGLContextAttributes attributes;
    emscripten_webgl_init_context_attributes(&attributes);
    attributes.alpha = attributes.depth = attributes.stencil = attributes.antialias = EM_FALSE;
    attributes.majorVersion = 1;
    const EMSCRIPTEN_WEBGL_CONTEXT_HANDLE context = emscripten_webgl_create_context("#water", &attributes);
    if (context <= 0 || emscripten_webgl_make_context_current(context) != EMSCRIPTEN_RESULT_SUCCESS) return false;
    // The ink draws from this generator.
    srand48(static_cast<long>(seed));
    water.emplace(look, seed);
    return true;
}

EMSCRIPTEN_KEEPALIVE int largestPicture() {
    GLint side = 0;
    glGetIntegerv(GL_MAX_TEXTURE_SIZE, &side);
    return side;
}

EMSCRIPTEN_KEEPALIVE Look* lookToFill() {
    return &look;
}
EMSCRIPTEN_KEEPALIVE void applyLook() {
    water->setLook(look);
}

// `which`: 0 for portrait, 1 for landscape, 2 for the light on the waves.
EMSCRIPTEN_KEEPALIVE std::uint8_t* pictureToFill(int which, int width, int height) {
    Picture& picture = which == 0 ? pictures.portrait : which == 1 ? pictures.landscape : pictures.light;
    picture = {width, height, {}};
    picture.rgba.resize(static_cast<std::size_t>(width) * static_cast<std::size_t>(height) * 4);
    return picture.rgba.data();
}
EMSCRIPTEN_KEEPALIVE void showPictures() {
    water->setPictures(std::exchange(pictures, {}));
}

EMSCRIPTEN_KEEPALIVE void resize(int width, int height) {
    water->resize(width, height);
}
EMSCRIPTEN_KEEPALIVE void setInk(bool withInk) {
    water->setInk(withInk);
}
EMSCRIPTEN_KEEPALIVE void setRain(bool falling) {
    water->setRain(falling);
}
EMSCRIPTEN_KEEPALIVE void clearInk() {
    water->clearInk();
}

EMSCRIPTEN_KEEPALIVE void touch(int action, int x, int y, float pressure) {
    water->touch(static_cast<TouchAction>(action), x, y, pressure);
}

EMSCRIPTEN_KEEPALIVE void renewContext() {
    forgetObjects();
    water->renewContext();
}

EMSCRIPTEN_KEEPALIVE int frame(double seconds) {
    const double start = emscripten_get_now();
    const LiveWater::Frame done = water->frame(seconds);
    if (done == LiveWater::Frame::drawn) water->noteWork((emscripten_get_now() - start) / 1000.0);
    return static_cast<int>(done);
}

}  // extern "C"
