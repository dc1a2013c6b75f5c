#include "host/engine_window.h"

#include <GLES2/gl2.h>

#include <cstddef>
#include <cstdint>

#include "jni/globals.h"

namespace tidemark {

EngineView lookIntoEngine() {
    EngineView view = {};
    const Texture<vec2>& flow = fluid.VelocityTex;
    view.gridWidth = flow.width;
    view.gridHeight = flow.height;
    for (const vec2* v = flow.row(0); v != flow.row(flow.height); ++v)
        view.velocity.insert(view.velocity.end(), {v->x, v->y});

    view.inkWidth = fluid.InkWidth;
    view.inkHeight = fluid.InkHeight;
    const auto texels = static_cast<std::size_t>(view.inkWidth) * static_cast<std::size_t>(view.inkHeight);
    std::vector<std::uint8_t> rgba(4 * texels);
    glBindFramebuffer(GL_FRAMEBUFFER, fluid.Density.Ping.FboHandle);
    glReadPixels(0, 0, view.inkWidth, view.inkHeight, GL_RGBA, GL_UNSIGNED_BYTE, rgba.data());
    glBindFramebuffer(GL_FRAMEBUFFER, 0);
    for (std::size_t i = 0; i < texels; ++i) {
        view.density.push_back(static_cast<float>(rgba[4 * i]) + static_cast<float>(rgba[4 * i + 1]) / 255.0f);
    }
    const auto tint = [](float channel) {
        return fluid.InkIntensity * ((1.5f - fluid.InkColorOffset) / channel - 1.0f);
    };
    view.tint[0] = tint(fluid.InkColor.r);
    view.tint[1] = tint(fluid.InkColor.g);
    view.tint[2] = tint(fluid.InkColor.b);
    return view;
}

}  // namespace tidemark
