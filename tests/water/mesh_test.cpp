#include "water/mesh.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

using Indices = std::vector<std::int16_t>;

TEST(Mesh, positionsRunColumnByColumnFromTheTopLeftCorner) {
    std::vector<float> p(3 * 9, 77.0f);
    fillPositions(p.data(), 9, 8, 6, 3, 3);
    const std::vector<float> expected = {-4, 3, 0,  -4, 0, 0, -4, -3, 0, 0, 3, 0,  0, 0,
                                         0,  0, -3, 0,  4, 3, 0,  4,  0, 0, 4, -3, 0};
    EXPECT_EQ(p, expected);

    p.assign(p.size(), 77.0f);
    fillPositions(p.data(), 2, 8, 6, 3, 3);
    EXPECT_EQ(p[5], 0.0f);
    EXPECT_EQ(p[6], 77.0f) << "only vertexCount vertices are written";
}

TEST(Mesh, indicesListTwoCounterClockwiseTrianglesPerCell) {
    Indices i(24, 77);
    fillIndices(i.data(), 3, 3);
    EXPECT_EQ(i, (Indices{0, 1, 4, 0, 4, 3, 3, 4, 7, 3, 7, 6, 1, 2, 5, 1, 5, 4, 4, 5, 8, 4, 8, 7}));

    i.assign(24, 77);
    fillIndices(i.data(), 1, 9);
    fillIndices(i.data(), 9, 1);
    EXPECT_EQ(i[0], 77) << "a single row or column has no cell";

    constexpr int n = 256;
    i.assign(6 * (n - 1) * (n - 1), 77);
    fillIndices(i.data(), n, n);
    std::vector<unsigned> last;
    for (std::size_t k = i.size() - 6; k < i.size(); ++k) last.push_back(static_cast<std::uint16_t>(i[k]));
    EXPECT_EQ(last, (std::vector<unsigned>{65278, 65279, 65535, 65278, 65535, 65534})) << "16 bits, unsigned";
}
