#include "gl/quad.h"

#include <cstddef>
#include <cstdint>

namespace {

struct Corner {
    std::int16_t x, y;  // clip space
    std::int16_t s, t;
};

constexpr Corner kQuad[4] = {{-1, -1, 0, 0}, {1, -1, 1, 0}, {-1, 1, 0, 1}, {1, 1, 1, 1}};

}  // namespace

void drawQuad(GLuint buffer) {
    // By contract every pass uploads the corners.
    glBindBuffer(GL_ARRAY_BUFFER, buffer);
    glBufferData(GL_ARRAY_BUFFER, sizeof kQuad, kQuad, GL_STATIC_DRAW);
    glEnableVertexAttribArray(0);
    glEnableVertexAttribArray(1);
    glVertexAttribPointer(0, 2, GL_SHORT, GL_FALSE, sizeof(Corner), nullptr);
    glVertexAttribPointer(1, 2, GL_SHORT, GL_FALSE, sizeof(Corner), reinterpret_cast<const void*>(offsetof(Corner, s)));
    glDrawArrays(GL_TRIANGLE_STRIP, 0, 4);
    // By contract attribute 1 stays enabled: the next pass draws the same quad.
    glDisableVertexAttribArray(0);
}
