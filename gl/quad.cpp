#include <cstddef>
#include <cstdint>

#include "fluid/fluid.h"
#include "gl/deletion.h"
#include "jni/log.h"

namespace {

struct Corner {
    std::int16_t x, y;  // clip space
    std::int16_t s, t;
};

constexpr Corner kQuad[4] = {{-1, -1, 0, 0}, {1, -1, 1, 0}, {-1, 1, 0, 1}, {1, 1, 1, 1}};

}  // namespace

void Fluid::CreateQuad() {
    LOG_INFO("CreateQuad");
    if (quadvbo) {
        LOG_INFO("glDelete quadvbo = %u", quadvbo);
        deleteBuffer(*this, quadvbo);
    }
    glGenBuffers(1, &quadvbo);
}

void Fluid::DrawQuad() {
    // By contract uploaded at every pass.
    glBindBuffer(GL_ARRAY_BUFFER, quadvbo);
    glBufferData(GL_ARRAY_BUFFER, sizeof kQuad, kQuad, GL_STATIC_DRAW);
    glEnableVertexAttribArray(0);
    glEnableVertexAttribArray(1);
    glVertexAttribPointer(0, 2, GL_SHORT, GL_FALSE, sizeof(Corner), nullptr);
    glVertexAttribPointer(1, 2, GL_SHORT, GL_FALSE, sizeof(Corner), reinterpret_cast<const void*>(offsetof(Corner, s)));
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    // By contract attribute 1 stays enabled: the next pass draws the same quad.
    glDisableVertexAttribArray(0);
}
