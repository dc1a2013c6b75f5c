#include "gl/precision.glsl"
#include "gl/density_texel.glsl"
// Semi-Lagrangian advection of the density, which is then multiplied by Dissipation. The velocity texel holds
// x = 255 R + G - 127 and y = 255 B + A - 127.
uniform FULL sampler2D VelocityTexture;
uniform FULL sampler2D SourceTexture;
uniform FULL vec2 TimeStep;
uniform FULL float BackwardStepSize;
uniform FULL float Dissipation;
uniform FULL vec2 Scale;
uniform FULL vec2 center;
uniform int drag;
varying FULL vec2 v_texCoord;

FULL vec2 encode(FULL float value) {
    value = clamp(value, -127.0, 127.0);
    FULL vec2 packed2 = fract(value * vec2(0.00392157, 1.0));
    packed2.x -= packed2.y / 255.0;
    return packed2;
}

void main() {
    FULL vec4 buf = texture2D(VelocityTexture, v_texCoord);
    FULL vec2 u = vec2(255.0 * buf.x + buf.y, 255.0 * buf.z + buf.w) - 127.0;
    FULL float backStep = BackwardStepSize;
    if (drag < 2) {
        FULL float d = distance(center, Scale * v_texCoord);
        if (d < 80.0) backStep = 0.0075 * d;
    }
    FULL vec2 coord = v_texCoord - backStep * TimeStep * u;
    gl_FragColor = vec4(encode(Dissipation * decodeDensity(texture2D(SourceTexture, coord))), 0.0, 0.0);
}
