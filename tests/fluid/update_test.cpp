#include <cmath>
#include <cstdlib>
#include <random>

#include "fluid/fluid.h"
#include "jni/globals.h"
#include "reference/ink_grid.h"
#include "tests/support/gl_test.h"

namespace {

constexpr int kWidth = 365;
constexpr int kHeight = 610;

// A touch, with its distances from the left and lower edges, and the resulting margin and source of an update. The
// source is initially of strength 7 and radius 90.
struct Row {
    int drag, x, up, margin;
    float strength, radius;
    bool projects;
};

constexpr Row kRows[] = {
    {0, 180, 300, 60, 7, 90, true},  {0, 30, 300, 12, 40, 4, true},   {0, 12, 300, 12, 40, 4, false},
    {0, 180, 598, 12, 40, 4, false}, {0, 180, 597, 12, 40, 4, true},  {1, 61, 61, 60, 7, 90, true},
    {1, 30, 300, 10, 7, 90, true},   {1, 10, 300, 10, 2, 2, false},   {1, 356, 300, 10, 2, 2, false},
    {-1, 60, 300, 60, 7, 90, false}, {-1, 304, 549, 60, 7, 90, true}, {2, 180, 550, 60, 7, 90, false},
    {2, 180, 60, 60, 7, 90, false},  {2, 305, 300, 60, 7, 90, false}, {2, 150, 200, 60, 7, 90, true},
    {2, -5, 300, 60, 7, 90, false},
};

class Update : public GlTest {
protected:
    void SetUp() override {
        GlTest::SetUp();
        engine.InitializeSetting(kWidth, kHeight, true);
        engine.InitializeGPU(true);
    }

    std::vector<vec2> field() const {
        return {
            engine.VelocityTex.data, engine.VelocityTex.data + engine.VelocityTex.width * engine.VelocityTex.height};
    }

    void expectField(const std::vector<vec2>& expected) const {
        const std::vector<vec2> actual = field();
        ASSERT_EQ(actual.size(), expected.size());
        for (std::size_t i = 0; i < actual.size(); ++i) {
            ASSERT_NEAR(actual[i].x, expected[i].x, 1e-4f) << i;
            ASSERT_NEAR(actual[i].y, expected[i].y, 1e-4f) << i;
        }
    }

    static float jittered(int position) {
        return static_cast<float>(position + (0.5 - double{static_cast<float>(lrand48()) * 4.656613e-10f}) * 10);
    }

    Fluid engine;
};

}  // namespace

TEST_F(Update, matchesThePlainLoopsAndUploadsTheField) {
    std::mt19937 random(1);
    std::uniform_real_distribution<float> speed(-150.0f, 150.0f);
    DX = 11;
    DY = -7;
    for (const Row& row : kRows) {
        SCOPED_TRACE(testing::Message() << "drag " << row.drag << " at " << row.x << ", " << row.up);
        POSITION_X = row.x;
        POSITION_Y = kHeight - row.up;
        engine.DragMode = row.drag;
        engine.SourceStrength = 7;
        engine.SourceRadius = 90;
        engine.Radius = 120;
        engine.TimeStep = 0.01f;
        InkGrid plain(kWidth, kHeight);
        for (vec2& v : plain.velocity) v = {speed(random), speed(random)};
        std::ranges::copy(plain.velocity, engine.VelocityTex.data);

        const vec2 scale = {365.0f / 30, 610.0f / 50};
        plain.advect.Scale = plain.diverge.Scale = plain.push.Scale = scale;
        plain.advect.drag = row.drag;
        plain.advect.center = {static_cast<float>(row.x), static_cast<float>(row.up)};
        plain.advect.delta = {11, 7};
        plain.advect.TimeStep = 0.01f;
        plain.advect.Dissipation = engine.VelocityDissipation;
        plain.diverge.SourceStrength = row.strength;
        plain.diverge.SourceRadius = row.radius;
        // Update calls lrand48 twice if it projects, otherwise never.
        srand48(row.x);
        if (row.projects) {
            plain.diverge.center.x = jittered(row.x);
            plain.diverge.center.y = jittered(row.up);
        }
        const long next = lrand48();
        kScalar.advection(plain.advect);
        plain.projected = plain.advected;
        if (row.projects) {
            kScalar.divergence(plain.diverge);
            plain.solvePressure(kScalar);
            kScalar.gradient(plain.subtract);
        }

        srand48(row.x);
        const GLuint ping = engine.Density.Ping.TextureHandle;
        glViewport(0, 0, 1, 1);
        engine.Update(0);
        EXPECT_EQ(lrand48(), next);
        EXPECT_EQ(engine.BoundaryMargin, row.margin);
        EXPECT_EQ(engine.SourceStrength, row.strength);
        EXPECT_EQ(engine.SourceRadius, row.radius);
        EXPECT_EQ(engine.isBoundary(POSITION_X, POSITION_Y), !row.projects);
        expectField(plain.projected);

        EXPECT_EQ(viewport(), (std::array{0, 0, engine.InkWidth, engine.InkHeight}));
        EXPECT_EQ(binding(GL_CURRENT_PROGRAM), static_cast<int>(engine.advect_density_program));
        EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
        EXPECT_EQ(binding(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
        EXPECT_EQ(binding(GL_TEXTURE_BINDING_2D), 0);
        EXPECT_EQ(engine.Density.Pong.TextureHandle, ping);
        glBindFramebuffer(GL_FRAMEBUFFER, engine.Velocity.Ping.FboHandle);
        std::vector<Rgba> packed(field().size());
        kScalar.packing(field().data(), packed.size(), packed[0].data());
        EXPECT_EQ(readPixels(engine.GridWidth, engine.GridHeight), packed);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);

        // The segment is independent of the touch.
        std::ranges::copy(plain.projected, engine.VelocityTex.data);
        engine.Perturb(100, kHeight - 150.0f, 130, kHeight - 190.0f);
        plain.push.previous = {100, 150};
        plain.push.current = {130, 190};
        plain.push.normal = {0.6f, 0.8f};
        plain.push.len = 50;
        plain.push.Radius = 120;
        kScalar.forcing(plain.push);
        expectField(row.projects ? plain.pushed : plain.projected);
    }
}

#ifdef __SSE2__
// MXCSR records whether an operation had a denormal operand while denormals-are-zero was off.
TEST_F(Update, flushesDenormals) {
    const auto meetsDenormals = [this](const auto& pass) {
        std::ranges::fill_n(engine.VelocityTex.data, static_cast<int>(field().size()), vec2{1e-40f, 1e-40f});
        _mm_setcsr(_mm_getcsr() & ~_MM_EXCEPT_MASK);
        pass();
        return (_mm_getcsr() & _MM_EXCEPT_DENORM) != 0;
    };
    POSITION_X = 180;
    POSITION_Y = 300;
    engine.Radius = 30;
    EXPECT_TRUE(meetsDenormals([this] {
        engine.AddVelocity(engine.VelocityTex, engine.VelocityTexTemp, {100, 300}, {180, 300});
    }));
    EXPECT_FALSE(meetsDenormals([this] { engine.Perturb(100, 300, 180, 300); }));
    EXPECT_FALSE(meetsDenormals([this] { engine.Update(0); }));
}
#endif
