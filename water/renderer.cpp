#include <cstddef>

#include "fluid/fluid.h"
#include "gl/texture_units.h"
#include "gl/uniforms.h"
#include "jni/log.h"

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

void Fluid::Ripple_Render(
    const float* positions, const float* heightAttribs, const short* indices, int positionFloats, int heightFloats,
    int indexCount, const float* mvp, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth, int numDetailsHeight,
    float refractiveIndex, float alphaMix, float alphaScale1, float alphaScale2, float fresnelRatio,
    float specularRatio, float exponent, bool withInk, bool landscape) {
    const GLuint program = ripple_program;
    if (!program || !v_buf) {
        // Drawing without the buffers of a set-up would read address 0.
        static bool reported = false;
        if (!reported) LOG_ERROR("Ripple_Render() without a set-up");
        reported = true;
        return;
    }
    glViewport(0, 0, ScreenWidth, ScreenHeight);
    glUseProgram(program);
    setUniform(program, "uMESH_SIZE_WIDTH", static_cast<float>(meshSizeWidth));
    setUniform(program, "uMESH_SIZE_HEIGHT", static_cast<float>(meshSizeHeight));
    setUniform(program, "uNUM_DETAILS_WIDTH", static_cast<float>(numDetailsWidth));
    setUniform(program, "uNUM_DETAILS_HEIGHT", static_cast<float>(numDetailsHeight));
    setUniform(program, "uRefractiveIndex", refractiveIndex);
    const auto aPosition = static_cast<GLuint>(glGetAttribLocation(program, "aPosition"));
    const auto aHeights = static_cast<GLuint>(glGetAttribLocation(program, "aHeights"));
    glUniformMatrix4fv(glGetUniformLocation(program, "uMVPMatrix"), 1, GL_FALSE, mvp);

    glBindBuffer(GL_ARRAY_BUFFER, 0);
    // By contract in every frame and as static, though positions and indices stay the same.
    upload(GL_ARRAY_BUFFER, v_buf, std::ptrdiff_t{positionFloats} * 4, positions);
    upload(GL_ARRAY_BUFFER, h_buf, std::ptrdiff_t{heightFloats} * 4, heightAttribs);
    upload(GL_ELEMENT_ARRAY_BUFFER, i_buf, std::ptrdiff_t{indexCount} * 2, indices);
    enableVec3(aHeights, h_buf);
    enableVec3(aPosition, v_buf);

    if (withInk) {
        const double a = 1.5 - double{InkColorOffset};
        const auto tint = [a](float channel) { return static_cast<float>(a / double{channel} - 1.0); };
        setUniform(program, "Scale", 1.0f / static_cast<float>(ScreenWidth), 1.0f / static_cast<float>(ScreenHeight));
        setUniform(program, "ink_color", tint(InkColor.r), tint(InkColor.g), tint(InkColor.b));
        setUniform(program, "intensity", InkIntensity * ClearInkValue);
        bindTextureUnit(GL_TEXTURE2, Density.Ping.TextureHandle);
        setUniform(program, "Density", 2);
    }

    setUniform(program, "alphaRatio1", alphaMix * alphaScale1);
    // By contract, though no shader declares it.
    setUniform(program, "alphaRatio2", static_cast<float>(double{alphaScale2} * (1.0 - double{alphaMix})));
    setUniform(program, "fresnelRatio", fresnelRatio);
    setUniform(program, "specularRatio", specularRatio);
    setUniform(program, "exponent", exponent);
    setUniform(program, "viewportHeight", static_cast<float>(ScreenHeight));
    bindTextureUnit(GL_TEXTURE0, landscape ? landscapeBG : portraitBG);
    setUniform(program, "sBGTexture", 0);
    bindTextureUnit(GL_TEXTURE1, environment);
    setUniform(program, "sWaterTexture", 1);

    glBindBuffer(GL_ELEMENT_ARRAY_BUFFER, i_buf);
    glDrawElements(GL_TRIANGLES, indexCount, GL_UNSIGNED_SHORT, nullptr);
    glDisableVertexAttribArray(aPosition);
    glDisableVertexAttribArray(aHeights);
    unbindTextureUnits();
}
