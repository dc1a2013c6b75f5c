#include "water/mesh.h"

#include <cstddef>
#include <initializer_list>

void fillPositions(
    float* positions, int vertexCount, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
    int numDetailsHeight) {
    if (numDetailsWidth < 1 || numDetailsHeight < 1) return;
    const float stepX = static_cast<float>(meshSizeWidth) / static_cast<float>(numDetailsWidth - 1);
    const float stepY = static_cast<float>(meshSizeHeight) / static_cast<float>(numDetailsHeight - 1);
    const float halfW = static_cast<float>(meshSizeWidth) * 0.5f;
    const float halfH = static_cast<float>(meshSizeHeight) * 0.5f;
    for (int i = 0; i < vertexCount; ++i) {
        const int column = i / numDetailsHeight;
        const int row = i % numDetailsHeight;
        float* vertex = positions + std::ptrdiff_t{i} * 3;
        vertex[0] = static_cast<float>(column) * stepX - halfW;
        vertex[1] = halfH - static_cast<float>(row) * stepY;
        vertex[2] = 0.0f;
    }
}

void fillIndices(std::int16_t* indices, int numDetailsWidth, int numDetailsHeight) {
    if (numDetailsHeight < 2) return;  // Without rows of cells, do not loop over a huge column count.
    for (int p = 1; p < numDetailsWidth; ++p) {
        for (int q = 1; q < numDetailsHeight; ++q) {
            // The corner is truncated to the 16 bits of an index. By contract the stride is numDetailsWidth, whereas
            // the positions use numDetailsHeight.
            const auto bottomRight = static_cast<std::uint16_t>(
                static_cast<unsigned>(q) * static_cast<unsigned>(numDetailsWidth) + static_cast<unsigned>(p));
            const auto bottomLeft = static_cast<std::uint16_t>(bottomRight - numDetailsWidth);
            const auto topLeft = static_cast<std::uint16_t>(bottomLeft - 1);
            const auto topRight = static_cast<std::uint16_t>(bottomRight - 1);
            for (const std::uint16_t corner : {topLeft, bottomLeft, bottomRight, topLeft, bottomRight, topRight}) {
                *indices++ = static_cast<std::int16_t>(corner);
            }
        }
    }
}
