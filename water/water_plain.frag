#include "gl/precision.glsl"
#include "water/light.glsl"
// Water without ink.
uniform float viewportHeight;

void main() {
    gl_FragColor = vec4(litWater(5.5), 1.0);
}
