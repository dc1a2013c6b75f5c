#include <algorithm>
#include <cstddef>

#include "base/log.h"
#include "fluid/buffers.h"
#include "fluid/fluid.h"
#include "fluid/ink_tuning.h"
#include "gl/shader_program.h"
#include "shaders/shaders.h"

namespace {

struct Program {
    GLuint& program;
    GLuint& vertexShader;
    GLuint& fragmentShader;
};

void build(Program made, const char* vertexSource, const char* fragmentSource) {
    made.vertexShader = zorloadShaderScript(GL_VERTEX_SHADER, vertexSource);
    made.fragmentShader = zorloadShaderScript(GL_FRAGMENT_SHADER, fragmentSource);
    made.program = zorCreateShaderProgram(made.vertexShader, made.fragmentShader);
}

template <class T, std::size_t size>
void setName(TShaderCore<T>& kernel, const char (&name)[size]) {
    static_assert(size <= sizeof kernel.name);
    std::copy_n(name, size, kernel.name);
}

}  // namespace

void Fluid::InitializeSetting(int width, int height, bool withInk) {
    LOG_INFO("InitializeSetting");
    InkColor = {1.0f, 1.0f, 1.0f};
    ScreenWidth = width;
    ScreenHeight = height;
    if (withInk) {
        const bool landscape = width > height;
        GridWidth = ScreenWidth / kCellPixels;
        GridHeight = ScreenHeight / kCellPixels;
        InkWidth = landscape ? kLongInkSide : kShortInkSide;
        InkHeight = landscape ? kShortInkSide : kLongInkSide;
        apply(kSetUpPreset);
        CellSize = kCellSize;
        NumJacobiIterations = kJacobiIterations;
        TimeStep = kTimeStep;
        GradientScale = kGradientScale;
        BackwardStepSize = kBackwardStep;
        ClearInkValue = 1.0f;
        InkIntensity = kSetUpInkIntensity;
        BoundaryMargin = kSetUpMargin;
    }
    const auto objects = glObjects();
    deleteGroup(objects, kPositionBuffer);
    glGenBuffers(1, &v_buf);
    deleteGroup(objects, kHeightBuffer);
    glGenBuffers(1, &h_buf);
    deleteGroup(objects, kIndexBuffer);
    glGenBuffers(1, &i_buf);
}

void Fluid::InitializeGPU(bool withInk) {
    LOG_INFO("InitializeGPU");
    if (withInk) LOG_INFO("bInk is true");
    const auto objects = glObjects();
    deleteGroup(objects, kRippleProgram);
    LOG_INFO("ripple_vertextShader zorCreateShaderProgram()");  // By contract "vertext".
    build(
        {ripple_program, ripple_vertexShader, ripple_fragmentShader}, kWaterVert,
        withInk ? kWaterInkFrag : kWaterPlainFrag);
    if (!withInk) {
        // A previous set-up with ink leaves its framebuffer bound, and without an ink frame nothing else unbinds it.
        if (Density.Pong.FboHandle) glBindFramebuffer(GL_FRAMEBUFFER, 0);
        return;
    }

    deleteGroup(objects, kAdvectDensityProgram);
    LOG_INFO("advect_density_program zorCreateShaderProgram()");
    build(
        {advect_density_program, advect_density_vertexShader, advect_density_fragmentShader}, kQuadVert,
        kAdvectDensityFrag);
    deleteGroup(objects, kAddInkProgram);
    LOG_INFO("addInk_program zorCreateShaderProgram()");
    build({addInk_program, addInk_vertexShader, addInk_fragmentShader}, kQuadVert, kAddInkFrag);

    setName(AdvectVelocityKernel, "AdvectVelocity");
    setName(AdvectDensityKernel, "AdvectDensity");
    setName(JacobiKernel, "Jacobi");
    setName(SubtractGradientKernel, "SubtractGradient");
    setName(ComputeDivergenceKernel, "ComputeDivergence");
    setName(AddInkKernel, "AddInk");
    setName(AddVelocityKernel, "AddVelocity");

    deleteGroup(objects, kVelocityTarget);
    Velocity.Ping = CreateSurface(GridWidth, GridHeight);
    deleteGroup(objects, kDensityTargets);
    Density = CreateData(InkWidth, InkHeight);
    allocateBuffers(*this);
    CreateQuad();
    // By contract set for the host; the library never enables blending.
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glViewport(0, 0, InkWidth, InkHeight);
    ClearSurface(Density.Ping, 0.0f, 0.0f, 0.0f, 0.0f);
    ClearSurface(Density.Pong, 0.0f, 0.0f, 0.0f, 0.0f);  // By contract its framebuffer stays bound.
}
