precision mediump float;
// Water without ink: the picture behind it, and the water texture on the waves.
#ifdef GL_FRAGMENT_PRECISION_HIGH
#define FULL highp
#else
#define FULL mediump
#endif
uniform sampler2D sWaterTexture;
uniform sampler2D sBGTexture;
uniform float alphaRatio1;
uniform float fresnelRatio;
uniform float specularRatio;
uniform float exponent;
uniform float viewportHeight;  // by contract declared, and not used
varying vec2 vWaterTextureCoord;
varying FULL vec2 vBGTexture1Coord;
varying vec3 vNormal;
varying vec3 vHalfVec;
varying float vHeights;

void main() {
    vec4 waterColor = texture2D(sWaterTexture, vWaterTextureCoord);
    vec4 bgColor = texture2D(sBGTexture, vBGTexture1Coord);
    float NdotHV = max(dot(vNormal, vHalfVec), 0.0);
    float specular = clamp(specularRatio * pow(NdotHV, exponent), 1.0, 5.5);
    float NdotL = max(dot(vNormal, vec3(5.0, -5.0, 1.0)), 0.0);
    float t = clamp(abs(vHeights), 0.0, 1.13);
    float fresnel = alphaRatio1 + fresnelRatio * clamp(NdotL - 0.99, 0.0, 0.3);
    gl_FragColor = vec4(t * specular * waterColor.rgb * fresnel + bgColor.rgb, 1.0);
}
