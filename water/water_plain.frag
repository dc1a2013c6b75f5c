#include "gl/precision.glsl"
#include "water/light.glsl"
uniform float viewportHeight;  // by contract declared, but not used

void main() {
    gl_FragColor = vec4(litWater(5.5), 1.0);
}
