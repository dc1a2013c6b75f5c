#include "fluid/fluid.h"
#include "fluid/touch.h"
#include "gl/texture_units.h"
#include "gl/uniforms.h"

void Fluid::AdvectDensity(Surface_ velocitySurface, Surface_ source, Surface_ destination, float dissipation) {
    const GLuint program = advect_density_program;
    const Touch touch = latestTouch(*this);
    const double texelsPerSpeed = 0.9 * double{TimeStep};
    glUseProgram(program);
    setUniform(program, "Scale", static_cast<float>(ScreenWidth), static_cast<float>(ScreenHeight));
    setUniform(
        program, "TimeStep", static_cast<float>(texelsPerSpeed / GridWidth),
        static_cast<float>(texelsPerSpeed / GridHeight));
    setUniform(program, "Dissipation", dissipation);
    setUniform(program, "BackwardStepSize", BackwardStepSize);
    setUniform(program, "center", static_cast<float>(touch.x), static_cast<float>(touch.y));
    setUniform(program, "drag", DragMode);
    setUniform(program, "SourceTexture", 1);  // By contract VelocityTexture keeps its default, unit 0.
    glBindFramebuffer(GL_FRAMEBUFFER, destination.FboHandle);
    bindTextureUnit(GL_TEXTURE0, velocitySurface.TextureHandle);
    bindTextureUnit(GL_TEXTURE1, source.TextureHandle);
    DrawQuad();
    ResetState();
}

void Fluid::AddInk(Surface_ source, Surface_ destination, int mode, Vector_ previous, Vector_ current, float) {
    const GLuint program = addInk_program;
    const Segment segment = segmentBetween(previous, current);
    glViewport(0, 0, InkWidth, InkHeight);
    glUseProgram(program);
    setUniform(program, "current", current.x, current.y);
    setUniform(program, "previous", previous.x, previous.y);
    setUniform(program, "normal", segment.normal.x, segment.normal.y);
    setUniform(program, "len", segment.length);
    setUniform(program, "Radius", Radius);
    setUniform(program, "ImpulseDensity", ImpulseDensity);  // By contract the member; the argument is ignored.
    setUniform(program, "Scale", static_cast<float>(ScreenWidth), static_cast<float>(ScreenHeight));
    setUniform(program, "mode", mode);
    setUniform(program, "Source", 0);
    glBindFramebuffer(GL_FRAMEBUFFER, destination.FboHandle);
    bindTextureUnit(GL_TEXTURE0, source.TextureHandle);
    DrawQuad();
    ResetState();
}
