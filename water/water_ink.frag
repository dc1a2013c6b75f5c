#include "gl/precision.glsl"
#include "gl/density_texel.glsl"
#include "water/light.glsl"
// color = litWater / (1 + intensity * density * ink_color); highlights are clamped lower than without ink.
uniform FULL sampler2D Density;
uniform FULL float intensity;
uniform FULL vec2 Scale;
uniform FULL vec3 ink_color;

void main() {
    FULL float w = intensity * decodeDensity(texture2D(Density, gl_FragCoord.xy * Scale));
    gl_FragColor = vec4(litWater(4.5) / (1.0 + w * ink_color), 1.0);
}
