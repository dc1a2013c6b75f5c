#include <cstring>

#include "fluid/buffers.h"
#include "fluid/fluid.h"
#include "gl/deletion.h"
#include "gl/shader_program.h"
#include "jni/log.h"
#include "shaders.h"

namespace {

struct Program {
    GLuint& program;
    GLuint& vertexShader;
    GLuint& fragmentShader;
};

// Deletes what an earlier set-up built, named in the log as `name`, and builds the program anew.
void rebuild(
    const Fluid& engine, Program made, const char* name, const char* announcement, const char* vertexSource,
    const char* fragmentSource) {
    if (made.program) {
        LOG_INFO("glDelete %s = %u", name, made.program);
        deleteShader(engine, made.vertexShader);
        deleteShader(engine, made.fragmentShader);
        deleteProgram(engine, made.program);
    }
    LOG_INFO("%s zorCreateShaderProgram()", announcement);
    made.vertexShader = zorloadShaderScript(GL_VERTEX_SHADER, vertexSource);
    made.fragmentShader = zorloadShaderScript(GL_FRAGMENT_SHADER, fragmentSource);
    made.program = zorCreateShaderProgram(made.vertexShader, made.fragmentShader);
}

void renewBuffer(const Fluid& engine, GLuint& buffer, const char* name) {
    if (buffer) {
        LOG_INFO("glDelete %s = %u", name, buffer);
        deleteBuffer(engine, buffer);
    }
    glGenBuffers(1, &buffer);
}

template <class T>
void setName(TShaderCore<T>& kernel, const char* name) {
    std::strncpy(kernel.name, name, sizeof kernel.name - 1);
}

}  // namespace

void Fluid::InitializeSetting(int width, int height, bool withInk) {
    LOG_INFO("InitializeSetting");
    InkColor = {1.0f, 1.0f, 1.0f};
    ScreenWidth = width;
    ScreenHeight = height;
    if (withInk) {
        CellSize = 2.5f;
        GridWidth = ScreenWidth / 12;
        GridHeight = ScreenHeight / 12;
        const bool landscape = width > height;
        InkWidth = landscape ? 512 : 256;
        InkHeight = landscape ? 256 : 512;
        Radius = 2.0f;
        ImpulseDensity = 200.0f;
        NumJacobiIterations = 5;
        TimeStep = 0.25f;
        GradientScale = 0.2f;
        VelocityDissipation = 0.9f;
        DensityDissipation = 0.92f;
        SourceStrength = 50.0f;
        SourceRadius = 40.0f;
        BackwardStepSize = 1.0f;
        ClearInkValue = 1.0f;
        InkIntensity = 0.2f;  // By contract; no frame shows it.
        DragMode = 0;
        BoundaryMargin = 10;
    }
    renewBuffer(*this, v_buf, "v_buf");
    renewBuffer(*this, h_buf, "h_buf");
    renewBuffer(*this, i_buf, "i_buf");
}

void Fluid::InitializeGPU(bool withInk) {
    LOG_INFO("InitializeGPU");
    if (withInk) LOG_INFO("bInk is true");
    // By contract "ripple_vertextShader".
    rebuild(
        *this, {ripple_program, ripple_vertexShader, ripple_fragmentShader}, "ripple_program", "ripple_vertextShader",
        kWaterVert, withInk ? kWaterInkFrag : kWaterPlainFrag);
    if (!withInk) {
        // A set-up for ink that no frame followed has left its target bound, which the water would draw into.
        if (inkTargetBound) glBindFramebuffer(GL_FRAMEBUFFER, 0);
        inkTargetBound = false;
        return;
    }

    rebuild(
        *this, {advect_density_program, advect_density_vertexShader, advect_density_fragmentShader},
        "advect_density_program", "advect_density_program", kQuadVert, kAdvectDensityFrag);
    rebuild(
        *this, {addInk_program, addInk_vertexShader, addInk_fragmentShader}, "addInk_program", "addInk_program",
        kQuadVert, kAddInkFrag);

    setName(AdvectVelocityKernel, "AdvectVelocity");
    setName(AdvectDensityKernel, "AdvectDensity");
    setName(JacobiKernel, "Jacobi");
    setName(SubtractGradientKernel, "SubtractGradient");
    setName(ComputeDivergenceKernel, "ComputeDivergence");
    setName(AddInkKernel, "AddInk");
    setName(AddVelocityKernel, "AddVelocity");

    if (Velocity.Ping.FboHandle) {
        LOG_INFO("glDelete Velocity.Ping.FboHandle = %u", Velocity.Ping.FboHandle);
        deleteSurface(*this, Velocity.Ping);
    }
    Velocity.Ping = CreateSurface(GridWidth, GridHeight);
    if (Density.Ping.FboHandle) {
        LOG_INFO("glDelete Density.Ping.FboHandle = %u", Density.Ping.FboHandle);
        deleteSurface(*this, Density.Ping);
        deleteSurface(*this, Density.Pong);
    }
    Density = CreateData(InkWidth, InkHeight);
    allocateBuffers(*this);
    CreateQuad();
    // By contract, for the host's own blending; the library never enables it.
    glBlendFunc(GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA);
    glViewport(0, 0, InkWidth, InkHeight);
    ClearSurface(Density.Ping, 0.0f, 0.0f, 0.0f, 0.0f);
    ClearSurface(Density.Pong, 0.0f, 0.0f, 0.0f, 0.0f);
    inkTargetBound = true;  // By contract left so.
}
