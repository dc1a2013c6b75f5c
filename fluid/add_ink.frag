#include "gl/precision.glsl"
#include "gl/density_texel.glsl"
// Adds ink along the segment from previous to current (mode 2) or around current (other modes). Positions are screen
// pixels, y up.
uniform FULL sampler2D Source;
uniform FULL vec2 Scale;
uniform FULL vec2 current;
uniform FULL vec2 previous;
uniform FULL vec2 normal;
uniform int mode;
uniform FULL float len;
uniform FULL float ImpulseDensity;
uniform FULL float Radius;
varying FULL vec2 v_texCoord;

FULL vec2 encode(FULL float value) {
    value = clamp(value, -127.0, 127.0);
    FULL vec2 packed2 = vec2(fract(value / 255.0), fract(value));
    packed2.x -= packed2.y / 255.0;
    return packed2;
}

void main() {
    FULL float ink = decodeDensity(texture2D(Source, v_texCoord));
    FULL vec2 p = Scale * v_texCoord;
    if (mode == 2) {
        FULL float t = dot(normal, p - previous);
        if (t > 0.0 && t < len) {
            FULL vec2 projected = previous + t * normal;
            FULL float d = distance(projected, p);
            if (d < Radius) ink += ImpulseDensity * exp(-d * d / (0.8 * Radius * Radius));
        }
    } else {
        FULL float d = distance(current, p);
        if (d < Radius) ink += ImpulseDensity / (1.0 + d);
    }
    gl_FragColor = vec4(encode(ink), 0.0, 0.0);
}
