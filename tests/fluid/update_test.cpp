#include <cmath>
#include <cstdlib>

#include "jni/gesture.h"
#include "jni/ink_frame.h"
#include "tests/support/gesture_state.h"
#include "tests/support/gl_test.h"
#include "tests/tshader/plain.h"
#include "tshader/velocity_packing.h"

namespace {

// The velocity half of one frame in plain loops, from the same field and the same random numbers.
struct Solver {
    const Fluid& f;
    std::vector<vec2> field;
    int margin = 60;
    float strength = f.SourceStrength;
    float radius = f.SourceRadius;
    const vec2 scale = {
        static_cast<float>(f.ScreenWidth) / static_cast<float>(f.GridWidth),
        static_cast<float>(f.ScreenHeight) / static_cast<float>(f.GridHeight)};

    Solver(const Fluid& engine, std::vector<vec2> start) : f(engine), field(std::move(start)) {}

    template <class T>
    Texture<T> view(std::vector<T>& texels) const {
        return {texels.data(), f.GridWidth, f.GridHeight};
    }

    // Runs the kernel, whose output has the field's size, into new texels.
    template <class T, class Kernel>
    std::vector<T> run(Kernel& kernel) const {
        std::vector<T> out(field.size());
        kernel.output = view(out);
        plain::run(kernel, out.data());
        return out;
    }

    bool inside(int m) const {
        const int up = f.ScreenHeight - POSITION_Y;
        return POSITION_X > m && up > m && POSITION_X < f.ScreenWidth - m && up < f.ScreenHeight - m;
    }

    void advect() {
        AdvectVelocityTShaderImpl kernel;
        kernel.VelocityTexture = kernel.SourceTexture = view(field);
        kernel.InverseSize = Vec2(1.0f / static_cast<float>(f.GridWidth), 1.0f / static_cast<float>(f.GridHeight));
        kernel.Scale = scale;
        kernel.TimeStep = f.TimeStep;
        kernel.Dissipation = f.VelocityDissipation;
        kernel.center = Vec2(static_cast<float>(POSITION_X), static_cast<float>(f.ScreenHeight - POSITION_Y));
        kernel.delta = Vec2(static_cast<float>(DX), static_cast<float>(-DY));
        kernel.drag = f.DragMode;
        field = run<vec2>(kernel);
    }

    void chooseMargin() {
        if (inside(60) || f.DragMode < 0 || f.DragMode > 1) return;
        margin = f.DragMode == 0 ? 12 : 10;
        if (f.DragMode == 1 && inside(10)) return;
        strength = f.DragMode == 0 ? 40.0f : 2.0f;
        radius = f.DragMode == 0 ? 4.0f : 2.0f;
    }

    static float jittered(int position) {
        return static_cast<float>(position + (0.5 - double{static_cast<float>(lrand48()) * 4.656613e-10f}) * 10);
    }

    void project() {
        ComputeDivergenceTShaderImpl diverge;
        diverge.Velocity = view(field);
        diverge.Scale = scale;
        diverge.HalfInvCellSize = 0.2f;
        diverge.SourceStrength = strength;
        diverge.SourceRadius = radius;
        diverge.center.x = jittered(POSITION_X);
        diverge.center.y = jittered(f.ScreenHeight - POSITION_Y);
        auto divergence = run<float>(diverge);

        JacobiTShaderImpl jacobi;
        jacobi.Divergence = view(divergence);
        jacobi.Alpha = -6.25f;
        jacobi.InverseBeta = 0.25f;
        std::vector<float> pressure(field.size());
        for (int i = 0; i < 5; ++i) {
            jacobi.Pressure = view(pressure);
            pressure = run<float>(jacobi);
        }

        SubtractGradientTShaderImpl subtract;
        subtract.Velocity = view(field);
        subtract.Pressure = view(pressure);
        subtract.GradientScale = 0.2f;
        field = run<vec2>(subtract);
    }

    // Whether the field was projected.
    bool update() {
        advect();
        chooseMargin();
        if (inside(margin)) project();
        return inside(margin);
    }

    void push(Vector_ previous, Vector_ current, float reach) {
        AddVelocityTShaderImpl kernel;
        kernel.Velocity = view(field);
        kernel.Scale = scale;
        kernel.previous = {previous.x, previous.y};
        kernel.current = {current.x, current.y};
        kernel.len = std::hypot(current.x - previous.x, current.y - previous.y);
        if (kernel.len == 0.0f) kernel.len = 1.0f;
        kernel.normal = (kernel.current - kernel.previous) / kernel.len;
        kernel.Radius = reach;
        field = run<vec2>(kernel);
    }
};

class Update : public GlTest {
protected:
    void setUp(int width, int height) {
        resetGestures();
        fluid.InitializeSetting(width, height, true);
        fluid.InitializeGPU(true);
        log.take();
    }

    static std::vector<vec2> field() {
        const Texture<vec2>& v = fluid.VelocityTex;
        return {v.data, v.data + v.width * v.height};
    }
};

}  // namespace

// Rounding differences double with every frame, so each frame starts from the library's own last field.
TEST_F(Update, aWholeGestureMovesTheFieldAsThePlainSolverDoes) {
    setUp(365, 610);
    int pushes = 0;
    int projections = 0;
    float liveliest = 0;
    for (int frame = 0; frame < 300; ++frame) {
        const double speed = 0.02 * (1 + frame / 60);
        const int x = 180 + static_cast<int>(150 * std::sin(frame * speed));
        const int y = 300 + static_cast<int>(270 * std::cos(frame * speed / 1.7));
        if (frame % 100 == 10) touch(x, y, 0, 1.0f);
        if (frame % 100 > 14 && frame % 100 < 80) touch(x, y, 2, 0.8f);
        if (frame % 100 == 80) touch(x, y, frame < 200 ? 1 : 3, 0.0f);

        Solver plainSolver(fluid, field());
        srand48(frame);
        const bool projects = plainSolver.update();
        const bool fast = state == 2 && isMovingEvent == 2;

        srand48(frame);
        stepInk({0.1f, 0.1f, 0.1f});
        ASSERT_EQ(fluid.BoundaryMargin, plainSolver.margin) << "frame " << frame;
        const bool isPushed = fast && !fluid.isBoundary(POSITION_X, POSITION_Y);
        if (isPushed) plainSolver.push(fluid.Previous, fluid.Current, 30);

        const auto actual = field();
        for (std::size_t i = 0; i < actual.size(); ++i) {
            const vec2 wanted = plainSolver.field[i];
            const float tolerance = 2e-4f + 1e-5f * (std::fabs(wanted.x) + std::fabs(wanted.y));
            ASSERT_NEAR(actual[i].x, wanted.x, tolerance) << "frame " << frame << ", texel " << i;
            ASSERT_NEAR(actual[i].y, wanted.y, tolerance) << "frame " << frame << ", texel " << i;
            liveliest = std::max(liveliest, std::fabs(actual[i].x));
        }
        pushes += isPushed;
        projections += projects;
    }
    EXPECT_GT(pushes, 5) << "fast drags push the flow";
    EXPECT_GT(projections, 100);
    EXPECT_LT(projections, 300);
    EXPECT_GT(liveliest, 5.0f) << "the gesture must stir the water";
}

TEST_F(Update, choosesTheMarginByDragModeAndDistance) {
    setUp(480, 800);
    struct Row {
        int drag, x, y, margin;
        float strength, radius;
        bool projects;
    };
    // The source starts at strength 7 and radius 9.
    for (const Row& row :
         {Row{0, 240, 400, 60, 7, 9, true},
          {0, 30, 400, 12, 40, 4, true},
          {0, 12, 400, 12, 40, 4, false},
          {0, 240, 792, 12, 40, 4, false},
          {1, 30, 400, 10, 7, 9, true},
          {1, 10, 400, 10, 2, 2, false},
          {1, 475, 400, 10, 2, 2, false},
          {-1, 60, 400, 60, 7, 9, false},
          {-1, 61, 400, 60, 7, 9, true},
          {2, 240, 740, 60, 7, 9, false},
          {2, 240, 739, 60, 7, 9, true}}) {
        SCOPED_TRACE(testing::Message() << "drag " << row.drag << " at " << row.x << ", " << row.y);
        fluid.DragMode = row.drag;
        fluid.SourceStrength = 7;
        fluid.SourceRadius = 9;
        POSITION_X = row.x;
        POSITION_Y = row.y;
        srand48(1);
        fluid.Update(0);
        EXPECT_EQ(fluid.BoundaryMargin, row.margin);
        EXPECT_EQ(fluid.SourceStrength, row.strength);
        EXPECT_EQ(fluid.SourceRadius, row.radius);
        // A projected frame draws twice from the generator, any other not at all.
        const long next = lrand48();
        srand48(1);
        if (row.projects) {
            lrand48();
            lrand48();
        }
        EXPECT_EQ(next, lrand48());
    }
}

TEST_F(Update, uploadsThePackedFieldAndLeavesTheStatedState) {
    setUp(480, 800);
    fluid.TimeStep = 0;  // advection then only smooths, and the middle of a flat patch stays
    fluid.VelocityDissipation = 1;
    const vec2 speeds[] = {{300, -300}, {0, 0.25f}, {-126.99f, 126.5f}, {std::nanf(""), 1}};
    for (const vec2 speed : speeds) {
        std::fill(fluid.VelocityTex.row(0), fluid.VelocityTex.row(fluid.GridHeight), speed);
        glViewport(0, 0, 1, 1);
        fluid.Update(0);
        glBindFramebuffer(GL_FRAMEBUFFER, fluid.Velocity.Ping.FboHandle);
        const auto texels = readPixels(fluid.GridWidth, fluid.GridHeight);
        glBindFramebuffer(GL_FRAMEBUFFER, 0);
        Rgba expected;
        packVelocity(&fluid.VelocityTex.row(10)[10], 1, expected.data());
        EXPECT_EQ(texels[static_cast<std::size_t>(10 * fluid.GridWidth + 10)], expected);
        if (speed.x == 300) {
            EXPECT_EQ(expected, (Rgba{254, 0, 0, 0}));
        }
    }
    GLint viewport[4];
    glGetIntegerv(GL_VIEWPORT, viewport);
    EXPECT_EQ(viewport[2], fluid.InkWidth);
    EXPECT_EQ(viewport[3], fluid.InkHeight);
    EXPECT_EQ(binding(GL_CURRENT_PROGRAM), static_cast<int>(fluid.advect_density_program));
    EXPECT_EQ(binding(GL_FRAMEBUFFER_BINDING), 0);
    EXPECT_EQ(binding(GL_ACTIVE_TEXTURE), GL_TEXTURE0);
}

#ifdef __SSE2__
// The processor notes whether it met a denormal that it was not told to take for zero.
TEST_F(Update, noPassIsSlowedDownByDenormals) {
    setUp(480, 800);
    const auto meetsDenormals = [](const auto& pass) {
        std::fill(fluid.VelocityTex.row(0), fluid.VelocityTex.row(fluid.GridHeight), vec2{1e-40f, 1e-40f});
        _mm_setcsr(_mm_getcsr() & ~_MM_EXCEPT_MASK);
        pass();
        return (_mm_getcsr() & _MM_EXCEPT_DENORM) != 0;
    };
    POSITION_X = 240;
    POSITION_Y = 400;
    fluid.Radius = 30;
    EXPECT_TRUE(meetsDenormals([] {
        fluid.AddVelocity(fluid.VelocityTex, fluid.VelocityTexTemp, {200, 400}, {280, 400});
    }));
    EXPECT_FALSE(meetsDenormals([] { fluid.Perturb(200, 400, 280, 400); }));
    EXPECT_FALSE(meetsDenormals([] { fluid.Update(0); }));
}
#endif
