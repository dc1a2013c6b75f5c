// pool PHOTO: water over a photo, in a window. The mouse or a finger drops rings and ink.
#include <SDL.h>
#include <SDL_image.h>

#include <algorithm>

#include "host/live_water.h"
#include "host/picture.h"

using namespace tidemark;

static Picture photo(const char* path) {
    SDL_Surface* const file = IMG_Load(path);
    SDL_Surface* const pixels = file ? SDL_ConvertSurfaceFormat(file, SDL_PIXELFORMAT_RGBA32, 0) : nullptr;
    if (!pixels) return {};
    const auto* const first = static_cast<std::uint8_t*>(pixels->pixels);
    return {pixels->w, pixels->h, {first, first + std::ptrdiff_t{pixels->pitch} * pixels->h}};
}

static double seconds() {
    return static_cast<double>(SDL_GetTicks64()) / 1000.0;
}

int main(int argc, char** argv) {
    const Picture ground = photo(argc == 2 ? argv[1] : "photo.jpg");
    if (!ground.width || SDL_Init(SDL_INIT_VIDEO) != 0) return 1;
    SDL_GL_SetAttribute(SDL_GL_CONTEXT_PROFILE_MASK, SDL_GL_CONTEXT_PROFILE_ES);
    SDL_GL_SetAttribute(SDL_GL_CONTEXT_MAJOR_VERSION, 2);
    SDL_GL_SetAttribute(SDL_GL_CONTEXT_MINOR_VERSION, 0);
    SDL_Window* const window = SDL_CreateWindow("Pool", 0, 0, 320, 320, SDL_WINDOW_OPENGL);
    if (!window || !SDL_GL_CreateContext(window)) return 1;

    const Pictures pictures = {ground, ground, ground};
    LiveWater water(sourceOf(pictures), 1);
    water.setView(320, 320, 1.0, seconds());
    water.setQuality(Quality::high);
    water.picturesChanged(kAllPictures);
    water.setInk(true);
    while (true) {
        const LiveWater::Frame frame = water.frame(seconds());
        if (frame == LiveWater::Frame::resize) water.resized();
        if (frame == LiveWater::Frame::drawn) SDL_GL_SwapWindow(window);
        const int wait = static_cast<int>(1000.0 * std::clamp(water.due() - seconds(), 0.0, 0.5));
        SDL_Event event;
        for (bool is = SDL_WaitEventTimeout(&event, wait); is; is = SDL_PollEvent(&event)) {
            const auto touch = [&](TouchAction action, int x, int y) {
                water.touch(action, static_cast<float>(x) / 320, static_cast<float>(y) / 320, 1.0f, seconds());
            };
            if (event.type == SDL_QUIT) return 0;
            if (event.type == SDL_WINDOWEVENT && event.window.event == SDL_WINDOWEVENT_EXPOSED) water.redraw();
            if (event.type == SDL_MOUSEBUTTONDOWN) touch(TouchAction::down, event.button.x, event.button.y);
            if (event.type == SDL_MOUSEBUTTONUP) touch(TouchAction::up, event.button.x, event.button.y);
            if (event.type == SDL_MOUSEMOTION && event.motion.state)
                touch(TouchAction::move, event.motion.x, event.motion.y);
        }
    }
}
