#include "gl/deletion.h"

#include <algorithm>
#include <initializer_list>

#include "fluid/fluid.h"

static bool isHeldOnce(GLuint name, std::initializer_list<GLuint> members) {
    return std::count(members.begin(), members.end(), name) == 1;
}

// Shaders and programs share their names.
static bool isHeldOnceByPrograms(const Fluid& f, GLuint name) {
    return isHeldOnce(
        name, {f.ripple_program, f.ripple_vertexShader, f.ripple_fragmentShader, f.advect_density_program,
               f.advect_density_vertexShader, f.advect_density_fragmentShader, f.addInk_program, f.addInk_vertexShader,
               f.addInk_fragmentShader});
}

void deleteBuffer(const Fluid& engine, GLuint buffer) {
    if (isHeldOnce(buffer, {engine.quadvbo, engine.v_buf, engine.h_buf, engine.i_buf})) glDeleteBuffers(1, &buffer);
}

void deleteTexture(const Fluid& engine, GLuint texture) {
    if (isHeldOnce(
            texture, {engine.Velocity.Ping.TextureHandle, engine.Density.Ping.TextureHandle,
                      engine.Density.Pong.TextureHandle, engine.portraitBG, engine.landscapeBG, engine.environment})) {
        glDeleteTextures(1, &texture);
    }
}

void deleteSurface(const Fluid& engine, const Surface_& surface) {
    if (isHeldOnce(
            surface.FboHandle,
            {engine.Velocity.Ping.FboHandle, engine.Density.Ping.FboHandle, engine.Density.Pong.FboHandle})) {
        glDeleteFramebuffers(1, &surface.FboHandle);
    }
    deleteTexture(engine, surface.TextureHandle);
}

void deleteShader(const Fluid& engine, GLuint shader) {
    if (isHeldOnceByPrograms(engine, shader)) glDeleteShader(shader);
}

void deleteProgram(const Fluid& engine, GLuint program) {
    if (isHeldOnceByPrograms(engine, program)) glDeleteProgram(program);
}
