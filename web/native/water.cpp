// The water of one canvas, as one instance of this module. web/package/src/native.ts gives it types.
//
// The instance is made with `context`, a WebGL context, and `upload(background, light, proportions)`, which fills these
// two WebGL textures: pictures go from the browser's decoder to the GPU and never through this module's memory. What
// the library is handed over are placeholders of one pixel.
#include <emscripten.h>

#include <cstdlib>
#include <optional>

#include "host/live_water.h"
#include "jni/globals.h"
#include "platform/log_filter.h"

// The page fills the look as an array of numbers in the order of look.properties.
static_assert(sizeof(int) == 4 && sizeof(float) == 4 && alignof(Look) == 4);

namespace {

Look look;
std::optional<LiveWater> water;
bool landscape = false;

// What was uploaded last.
GLuint background = 0;
GLuint light = 0;
bool uploadDue = false;

}  // namespace

// clang-format off
EM_JS(void, useContext, (), {
    GL.makeContextCurrent(GL.registerContext(Module["context"], {majorVersion: 1}));
});

EM_JS(void, upload, (GLuint background, GLuint light, double proportions), {
    Module["upload"](GL.textures[background], GL.textures[light], proportions);
});

// The names of objects that were lost with their context must not reach the new one.
EM_JS(void, forgetObjects, (), {
    for (const table of [GL.buffers, GL.framebuffers, GL.programs, GL.shaders, GL.textures]) table.fill(null);
});
// clang-format on

namespace {

void uploadWhereNew() {
    water->prepare();
    const GLuint shown = landscape ? fluid.landscapeBG : fluid.portraitBG;
    if (!uploadDue && shown == background && fluid.environment == light) return;
    background = shown;
    light = fluid.environment;
    uploadDue = false;
    upload(background, light, water->proportions());
}

}  // namespace

extern "C" {

// Sizes are in pixels of the canvas here and below.
EMSCRIPTEN_KEEPALIVE void begin(std::uint32_t seed) {
    quietenLog();
    useContext();
    // The ink draws from this generator.
    srand48(static_cast<long>(seed));
    water.emplace(look, seed);
    const Picture pixel = {1, 1, {0, 0, 0, 255}};
    water->setPictures({pixel, pixel, pixel});
}

EMSCRIPTEN_KEEPALIVE Look* lookToFill() {
    return &look;
}
EMSCRIPTEN_KEEPALIVE void applyLook() {
    water->setLook(look);
}
EMSCRIPTEN_KEEPALIVE void resize(int width, int height) {
    landscape = width > height;
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
EMSCRIPTEN_KEEPALIVE void splash(int x, int y, float pressure) {
    water->splash(x, y, pressure);
}

// Asks for another upload.
EMSCRIPTEN_KEEPALIVE void renewPictures() {
    uploadDue = true;
    water->redraw();
}
EMSCRIPTEN_KEEPALIVE void renewContext() {
    forgetObjects();
    water->renewContext();
}
EMSCRIPTEN_KEEPALIVE int frame(double seconds) {
    const double start = emscripten_get_now();
    if (!water->isResting()) uploadWhereNew();
    const LiveWater::Frame done = water->frame(seconds);
    if (done == LiveWater::Frame::drawn) water->noteWork((emscripten_get_now() - start) / 1000.0);
    return static_cast<int>(done);
}

}  // extern "C"
