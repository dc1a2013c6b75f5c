#include "water/renderer.h"

#include <cstddef>

#include "base/log.h"
#include "gl/texture_units.h"
#include "gl/uniforms.h"

namespace {

void upload(GLenum target, GLuint buffer, std::ptrdiff_t bytes, const void* data) {
    glBindBuffer(target, buffer);
    glBufferData(target, bytes, data, GL_STATIC_DRAW);
    glBindBuffer(target, 0);
}

void enableVec3(GLuint attribute, GLuint buffer) {
    glBindBuffer(GL_ARRAY_BUFFER, buffer);
    glVertexAttribPointer(attribute, 3, GL_FLOAT, GL_FALSE, 0, nullptr);
    glEnableVertexAttribArray(attribute);
}

}  // namespace

void drawWater(
    const WaterObjects& objects, int viewWidth, int viewHeight, const WaterMesh& mesh, const WaterLight& light,
    const WaterInk* ink) {
    const GLuint program = objects.program;
    if (!objects.positions) {
        // Without a bound buffer GL takes the attribute offsets as addresses, and the draw would read address 0.
        static bool reported = false;
        if (!reported) LOG_ERROR("Ripple_Render() without the buffers of onInitSetting()");
        reported = true;
        return;
    }
    glViewport(0, 0, viewWidth, viewHeight);
    glUseProgram(program);
    setUniform(program, "uMESH_SIZE_WIDTH", static_cast<float>(mesh.sizeWidth));
    setUniform(program, "uMESH_SIZE_HEIGHT", static_cast<float>(mesh.sizeHeight));
    setUniform(program, "uNUM_DETAILS_WIDTH", static_cast<float>(mesh.detailsWidth));
    setUniform(program, "uNUM_DETAILS_HEIGHT", static_cast<float>(mesh.detailsHeight));
    setUniform(program, "uRefractiveIndex", light.refractiveIndex);
    const auto aPosition = static_cast<GLuint>(glGetAttribLocation(program, "aPosition"));
    const auto aHeights = static_cast<GLuint>(glGetAttribLocation(program, "aHeights"));
    glUniformMatrix4fv(glGetUniformLocation(program, "uMVPMatrix"), 1, GL_FALSE, mesh.mvp);

    // By contract every frame uploads all buffers with GL_STATIC_DRAW, although positions and indices do not change.
    glBindBuffer(GL_ARRAY_BUFFER, 0);
    upload(GL_ARRAY_BUFFER, objects.positions, std::ptrdiff_t{mesh.positionFloats} * 4, mesh.positions);
    upload(GL_ARRAY_BUFFER, objects.heights, std::ptrdiff_t{mesh.heightFloats} * 4, mesh.heightAttribs);
    upload(GL_ELEMENT_ARRAY_BUFFER, objects.indices, std::ptrdiff_t{mesh.indexCount} * 2, mesh.indices);
    enableVec3(aHeights, objects.heights);
    enableVec3(aPosition, objects.positions);

    if (ink) {
        setUniform(program, "Scale", 1.0f / static_cast<float>(viewWidth), 1.0f / static_cast<float>(viewHeight));
        setUniform(program, "ink_color", ink->tint[0], ink->tint[1], ink->tint[2]);
        setUniform(program, "intensity", ink->intensity);
        bindTextureUnit(GL_TEXTURE2, ink->density);
        setUniform(program, "Density", 2);
    }

    setUniform(program, "alphaRatio1", light.alphaMix * light.alphaScale1);
    // By contract set, although no shader declares it.
    setUniform(program, "alphaRatio2", static_cast<float>(double{light.alphaScale2} * (1.0 - double{light.alphaMix})));
    setUniform(program, "fresnelRatio", light.fresnelRatio);
    setUniform(program, "specularRatio", light.specularRatio);
    setUniform(program, "exponent", light.exponent);
    setUniform(program, "viewportHeight", static_cast<float>(viewHeight));
    bindTextureUnit(GL_TEXTURE0, objects.background);
    setUniform(program, "sBGTexture", 0);
    bindTextureUnit(GL_TEXTURE1, objects.light);
    setUniform(program, "sWaterTexture", 1);

    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, objects.indices);
    glDrawElements(GL_TRIANGLES, mesh.indexCount, GL_UNSIGNED_SHORT, nullptr);
    glDisableVertexAttribArray(aPosition);
    glDisableVertexAttribArray(aHeights);
    unbindTextureUnits();
}
