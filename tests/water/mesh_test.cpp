#include "water/mesh.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

TEST(Mesh, positionsRunColumnByColumnFromTheTopLeftCorner) {
    std::vector<float> p(3 * 9 + 3, 77.0f);
    fillPositions(p.data(), 9, 8, 6, 3, 3);
    const std::vector<float> expected = {-4, 3,  0, -4, 0, 0, -4, -3, 0, 0, 3,  0, 0,  0,  0,
                                         0,  -3, 0, 4,  3, 0, 4,  0,  0, 4, -3, 0, 77, 77, 77};
    EXPECT_EQ(p, expected);

    std::fill(p.begin(), p.end(), 77.0f);
    fillPositions(p.data(), 2, 8, 6, 3, 3);
    EXPECT_EQ(p[5], 0.0f);
    EXPECT_EQ(p[6], 77.0f) << "only vertexCount vertices are written";
}

TEST(Mesh, indicesListTwoCounterClockwiseTrianglesACell) {
    std::vector<std::int16_t> i(24, 77);
    fillIndices(i.data(), 3, 3);
    EXPECT_EQ(i, (std::vector<std::int16_t>{0, 1, 4, 0, 4, 3, 3, 4, 7, 3, 7, 6, 1, 2, 5, 1, 5, 4, 4, 5, 8, 4, 8, 7}));

    std::fill(i.begin(), i.end(), std::int16_t{77});
    fillIndices(i.data(), 1, 9);
    fillIndices(i.data(), 9, 1);
    EXPECT_EQ(i[0], 77) << "a single row or column has no cell";
}

TEST(Mesh, trianglesOfTheLargestMeshCoverItOnce) {
    constexpr int n = 256;
    std::vector<float> p(3 * n * n);
    std::vector<std::int16_t> indices(6 * (n - 1) * (n - 1));
    fillPositions(p.data(), n * n, 9, 16, n, n);
    fillIndices(indices.data(), n, n);
    double area = 0.0;
    unsigned last = 0;
    for (std::size_t t = 0; t < indices.size(); t += 3) {
        const float* corner[3];
        for (std::size_t k = 0; k < 3; ++k) {
            const unsigned vertex = static_cast<std::uint16_t>(indices[t + k]);
            last = std::max(last, vertex);
            corner[k] = &p[3 * vertex];
        }
        const double twice = double{corner[1][0] - corner[0][0]} * double{corner[2][1] - corner[0][1]} -
                             double{corner[2][0] - corner[0][0]} * double{corner[1][1] - corner[0][1]};
        ASSERT_GT(twice, 0.0) << "triangle " << t / 3 << " is not counter-clockwise";
        area += twice / 2;
    }
    EXPECT_NEAR(area, 9.0 * 16.0, 1e-3);
    EXPECT_EQ(last, 65535u);
}
