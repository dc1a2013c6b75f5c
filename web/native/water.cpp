// The water of one canvas, as one instance of this module. web/package/src/native.ts declares its functions.
//
// The instance is created with `context`, a WebGL context, and `load(slot, width, height)`, which fills the bound
// texture: pictures go from the browser's decoder to the GPU without passing through this module's memory. The library
// receives a placeholder of one pixel.
#include <emscripten.h>

#include <cmath>
#include <cstdlib>
#include <optional>

#include "host/live_water.h"
#include "host/log_filter.h"
#include "host/look_values.h"
#include "host/picture.h"

using namespace tidemark;

namespace {

Look look;
std::optional<LiveWater> water;

// The name of a look's value, written by the page.
char name[32];

// The sizes of the latest transfer of each slot.
struct {
    int width, height;
} wanted[3];

}  // namespace

// clang-format off
EM_JS(void, useContext, (), {
    if (GL.currentContext) GL.deleteContext(GL.currentContext.handle);
    GL.makeContextCurrent(GL.registerContext(Module["context"], {majorVersion: 1}));
});

EM_JS(void, load, (int slot, int width, int height), {
    Module["load"](slot, width, height);
});

// The names of objects that were lost with the old context must not be used in the new one.
EM_JS(void, forgetObjects, (), {
    for (const table of [GL.buffers, GL.framebuffers, GL.programs, GL.shaders, GL.textures]) table.fill(null);
});
// clang-format on

namespace {

PictureSource pageSource() {
    static const Picture placeholder = {1, 1, {0, 0, 0, 255}};
    return {
        [](PictureSlot slot, int width, int height) {
            wanted[static_cast<int>(slot)] = {width, height};
            handOver(slot, placeholder);
        },
        [](PictureSlot slot) {
            const auto [width, height] = wanted[static_cast<int>(slot)];
            load(static_cast<int>(slot), width, height);
        }};
}

}  // namespace

extern "C" {

EMSCRIPTEN_KEEPALIVE void begin(std::uint32_t seed) {
    quietenLog();
    useContext();
    // The library's ink uses this generator.
    srand48(static_cast<long>(seed));
    water.emplace(pageSource(), seed);
}

// A look is set value by value, each by name, and then applied. setLookValue returns false if the look has no such
// value or it is outside its limits.
EMSCRIPTEN_KEEPALIVE char* nameToFill() {
    return name;
}
EMSCRIPTEN_KEEPALIVE bool setLookValue(double value) {
    const LookField* const field = fieldNamed(name);
    return field && setValue(look, *field, value);
}
EMSCRIPTEN_KEEPALIVE void applyLook() {
    water->setLook(look);
}

// CSS pixels, and display pixels per CSS pixel.
EMSCRIPTEN_KEEPALIVE void setView(double width, double height, double density, double seconds) {
    water->setView(width, height, density, seconds);
}
EMSCRIPTEN_KEEPALIVE void setQuality(int quality) {
    water->setQuality(static_cast<Quality>(quality));
}
EMSCRIPTEN_KEEPALIVE void setShortestFrame(double seconds) {
    water->setShortestFrame(seconds);
}
// The size that the canvas must get after frame() has returned `resize`; then call resized().
EMSCRIPTEN_KEEPALIVE int width() {
    return water->width();
}
EMSCRIPTEN_KEEPALIVE int height() {
    return water->height();
}
EMSCRIPTEN_KEEPALIVE void resized() {
    water->resized();
}

EMSCRIPTEN_KEEPALIVE void setInk(bool withInk) {
    water->setInk(withInk);
}
EMSCRIPTEN_KEEPALIVE void setRain(bool falling) {
    water->setRain(falling);
}
EMSCRIPTEN_KEEPALIVE void setBreezeAlways(bool always) {
    water->setBreezeAlways(always);
}
EMSCRIPTEN_KEEPALIVE void clearInk() {
    water->clearInk();
}

// Positions are fractions of the canvas. A negative pressure means a finger or a mouse, other values a pen.
EMSCRIPTEN_KEEPALIVE void touch(int action, float x, float y, float pressure, double seconds) {
    water->touch(static_cast<TouchAction>(action), x, y, pressure < 0.0f ? 1.0f : penWeight(pressure), seconds);
}
// Raises a ripple with ink.
EMSCRIPTEN_KEEPALIVE void drop(float x, float y, float weight) {
    water->splash(x, y, weight, true);
}
EMSCRIPTEN_KEEPALIVE void splash(float x, float y, float weight) {
    water->splash(x, y, weight);
}

// A sum of 1 for the portrait, 2 for the landscape and 4 for the light.
EMSCRIPTEN_KEEPALIVE void picturesChanged(unsigned which) {
    water->picturesChanged(which);
}
// Returns the colour by which load() multiplies a picture, 0xRRGGBB.
EMSCRIPTEN_KEEPALIVE int shade(int slot, float brightness) {
    const Shade shade = water->shade(static_cast<PictureSlot>(slot), brightness);
    int color = 0;
    for (const float factor : {shade.red, shade.green, shade.blue}) {
        color = 256 * color + static_cast<int>(std::lround(255.0f * factor));
    }
    return color;
}
EMSCRIPTEN_KEEPALIVE void redraw() {
    water->redraw();
}
EMSCRIPTEN_KEEPALIVE void renewContext() {
    useContext();
    forgetObjects();
    water->renewContext();
}
EMSCRIPTEN_KEEPALIVE int frame(double seconds) {
    return static_cast<int>(water->frame(seconds));
}

}  // extern "C"
