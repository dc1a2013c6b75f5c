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
    double radius;  // of its crest, view heights
    float height;
};

// Measures the ring of a drop in the middle, half a second later, on a mesh of `vertices` a side.
Ring ringAfterHalfASecond(const Look& look, int width, int height, int vertices) {
    const WaveLattice lattice = latticeFor(look, width, height);
    const int n = lattice.points;
    std::vector<float> heights(static_cast<std::size_t>(n * n));
    std::vector<float> velocity(heights.size());
    addRipple({heights.data(), n, n, n, n}, -0.5f, -0.5f, 1.0f);  // on the middle of n points
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
        heights.push_back(static_cast<float>(2 * (i / kPoints) + i % kPoints));  // 2 a column, 1 a row
    }
    constexpr int kVertices = 31;  // a vertex on every point and between
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
