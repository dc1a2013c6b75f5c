#include "gl/precision.glsl"
#include "water/light.glsl"
// Water without ink.
uniform float viewportHeight;  // by contract declared, and not used

void main() {
    gl_FragColor = vec4(litWater(5.5), 1.0);
}
