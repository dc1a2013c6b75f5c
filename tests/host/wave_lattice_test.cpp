#include "host/wave_lattice.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

#include "host/surface_mesh.h"
#include "water/ripples.h"
#include "water/waves.h"

using namespace tidemark;

namespace {

struct Ring {
    double radius;  // radius of the crest in view heights
    float height;
};

// Measures the ring of a central drop after half a second, with a mesh of vertices x vertices.
Ring ringAfterHalfASecond(const Look& look, int width, int height, int vertices) {
    const WaveLattice lattice = latticeFor(look, width, height);
    const int n = lattice.points;
    std::vector<float> heights(static_cast<std::size_t>(n * n));
    std::vector<float> velocity(heights.size());
    addRipple({heights.data(), n, n, n, n}, -0.5f, -0.5f, 1.0f);  // at the middle of n points
    for (int i = 0; i < lattice.stepsPerSecond / 2; ++i) {
        stepWaves(velocity.data(), heights.data(), {1, 1, n - 1, n - 1, n}, false, lattice.damping, lattice.waveSpeed);
    }
    std::vector<float> attribs(static_cast<std::size_t>(3 * vertices * vertices));
    std::vector<std::int16_t> indices(2 * attribs.size());
    SurfaceMesh(n, vertices, 1.0, 1.0).gather(heights.data(), velocity.data(), 0.0f, attribs.data(), indices.data());
    Ring ring = {0.0, 0.0f};
    for (int i = 0; i < vertices * vertices; ++i) {
        const float h = attribs[static_cast<std::size_t>(3 * i)];
        const auto place = [=](int line) { return static_cast<double>(line) / (vertices - 1) - 0.5; };
        if (h > ring.height) ring = {std::hypot(place(i / vertices), place(i % vertices)), h};
    }
    const double longer = std::max(width, height);
    ring.radius *= look.pictureZoom * longer / std::sqrt(width * height * 16.0 / 9.0);
    return ring;
}

}  // namespace

TEST(WaveLattice, ringsAreTheSameOnAnyViewAndMeshAndAtAnyRate) {
    const Look look;
    const Ring usual = ringAfterHalfASecond(look, 540, 960, 128);
    EXPECT_GT(usual.height, 0.01f);
    for (const auto& [width, height] : {std::pair{540, 960}, {1440, 900}, {768, 1024}, {700, 700}, {1080, 2400}}) {
        for (const int vertices : {96, 128, 192, 256}) {
            SCOPED_TRACE(testing::Message() << width << " x " << height << ", " << vertices);
            const Ring ring = ringAfterHalfASecond(look, width, height, vertices);
            EXPECT_NEAR(ring.radius, usual.radius, 0.05 * usual.radius);
            EXPECT_NEAR(ring.height, usual.height, 0.05f * usual.height);
        }
    }
}

TEST(WaveLattice, fastRingsTakeShorterStepsAndStayStable) {
    Look look;
    for (const float speed : {0.3f, 0.6f, 1.0f, 3.0f}) {
        look.ringSpeed = speed;
        const WaveLattice lattice = latticeFor(look, 540, 960);
        EXPECT_LE(lattice.waveSpeed, 0.45f) << speed;
        EXPECT_GT(lattice.damping, 0.9f);
        EXPECT_LT(ringAfterHalfASecond(look, 540, 960, 128).height, 3.0f) << speed;
    }
    look.waveSpeed = 0.2f;
    look.damping = 0.9f;
    const WaveLattice byHand = latticeFor(look, 540, 960);
    EXPECT_EQ(byHand.waveSpeed, 0.2f);
    EXPECT_EQ(byHand.damping, 0.9f);
}

TEST(SurfaceMesh, isLevelBeyondItsEdgeAndKeepsSlopes) {
    constexpr int kPoints = 16;
    std::vector<float> heights;
    for (int i = 0; i < kPoints * kPoints; ++i) {
        heights.push_back(static_cast<float>(2 * (i / kPoints) + i % kPoints));  // 2 per column, 1 per row
    }
    constexpr int kVertices = 31;  // vertices on the points and halfway between
    std::vector<float> attribs(3 * kVertices * kVertices);
    std::vector<std::int16_t> indices(2 * attribs.size());
    SurfaceMesh mesh(kPoints, kVertices, 1.0, 1.0);
    mesh.layCells(indices.data());
    mesh.gather(heights.data(), heights.data(), 0.0f, attribs.data(), indices.data());
    EXPECT_EQ(std::pair(indices[2], indices[3]), std::pair(indices[5], indices[1])) << "the diagonal runs level";
    const float* const middle = attribs.data() + 3 * (15 * kVertices + 15);
    EXPECT_NEAR(middle[0], 7.5f * 3.0f, 1e-4f);
    EXPECT_NEAR(middle[1] - middle[0], 2.0f, 1e-4f) << "the neighbour to the right";
    EXPECT_NEAR(middle[2] - middle[0], -1.0f, 1e-4f) << "the neighbour above";
    const float* const last = attribs.data() + 3 * (kVertices * kVertices - 1);
    EXPECT_LT(std::fabs(last[1] - last[0]), 0.5f);
}

namespace {

// Computes the surface of SurfaceMesh::gather() one vertex at a time.
struct PlainSurface {
    struct Place {
        int cell;
        float weights[4];
    };
    Place place(int vertex) const {
        const double at = static_cast<double>(vertex) * (points - 1) / (vertices - 1);
        const int cell = std::min(static_cast<int>(at), points - 2);
        const auto t = static_cast<float>(at - cell);
        return {
            cell,
            {(1.0f - t) * (1.0f - t) * (1.0f - t) / 6.0f, ((3.0f * t - 6.0f) * t * t + 4.0f) / 6.0f,
             (((3.0f - 3.0f * t) * t + 3.0f) * t + 1.0f) / 6.0f, t * t * t / 6.0f}};
    }

    template <class Value>
    static float blend(const Place& place, Value value) {
        const float* const w = place.weights;
        return w[0] * value(place.cell - 1) + w[1] * value(place.cell) + w[2] * value(place.cell + 1) +
               w[3] * value(place.cell + 2);
    }

    // Returns the height at a vertex, or `right` and `above` cells from it.
    float height(int column, int row, int right, int above) const {
        const auto inside = [this](int i) { return std::clamp(i, 0, points - 1); };
        return blend(place(column), [&](int c) {
            return blend(place(row), [&](int r) {
                return heights[static_cast<std::size_t>(inside(c + right) * points + inside(r - above))];
            });
        });
    }

    int points, vertices;
    std::vector<float> heights;
};

}  // namespace

TEST(SurfaceMesh, equalsThePlainFormulaBitForBit) {
    struct Size {
        int points, vertices;
        double width, height;
    };
    for (const Size size :
         {Size{16, 31, 1, 1}, {40, 96, 9.0 / 16, 1}, {60, 33, 1, 0.7}, {9, 42, 0.2, 0.6}, {2, 2, 1, 1}}) {
        SCOPED_TRACE(testing::Message() << size.points << ", " << size.vertices);
        WaveLattice lattice = latticeFor({}, 540, 960);
        lattice.points = size.points;
        Breeze breeze(lattice);
        breeze.blow(0.5f, 12.3);
        std::vector<float> heights, velocity;
        for (int i = 0; i < size.points * size.points; ++i) {
            heights.push_back(static_cast<float>(i * i % 101) / 50.0f - 1.0f);
            velocity.push_back(static_cast<float>(i * i % 37) / 90.0f);
        }
        PlainSurface plain = {size.points, size.vertices, heights};
        for (std::size_t i = 0; i < heights.size(); ++i) plain.heights[i] = heights[i] + 0.3f * velocity[i];
        for (int c = 0; c < size.points; ++c) breeze.add(c, 0, size.points, plain.heights.data() + c * size.points);

        SurfaceMesh mesh(size.points, size.vertices, size.width, size.height);
        const auto [firstColumn, columns] = mesh.columns();
        const auto [firstRow, rows] = mesh.rows();
        std::vector<std::int16_t> indices(static_cast<std::size_t>(6 * (columns - 1) * (rows - 1)));
        mesh.layCells(indices.data());
        std::vector<float> expected;
        std::vector<std::int16_t> expectedIndices = indices;
        for (int i = 0; i < columns * rows; ++i) {
            const int c = firstColumn + i / rows;
            const int r = firstRow + i % rows;
            for (const auto& [right, above] : {std::pair{0, 0}, {1, 0}, {0, 1}}) {
                expected.push_back(plain.height(c, r, right, above));
            }
        }
        const auto slopes = [&](int vertex) {
            const float* const v = expected.data() + 3 * vertex;
            return (v[0] - v[1]) * (v[0] - v[2]);
        };
        for (int cell = 0; cell < (columns - 1) * (rows - 1); ++cell) {
            std::int16_t* const corners = expectedIndices.data() + 6 * cell;
            const int left = corners[0];
            const int right = corners[5];
            if (!std::signbit(slopes(left) + slopes(left + 1) + slopes(right) + slopes(right + 1))) continue;
            corners[2] = corners[5];
            corners[3] = corners[1];
        }
        constexpr float kUntouched = 1234.0f;
        expected.push_back(kUntouched);
        std::vector<float> attribs(expected.size(), kUntouched);
        // A second frame with other heights does not depend on the first.
        mesh.gather(velocity.data(), heights.data(), 1.0f, attribs.data(), indices.data());
        mesh.gather(heights.data(), velocity.data(), 0.3f, attribs.data(), indices.data(), &breeze);
        EXPECT_EQ(attribs, expected);
        EXPECT_EQ(indices, expectedIndices);
    }
}
