precision mediump float;
// Water with ink: as water_plain.frag, with its highlights a little lower, and the colour divided by the ink. Density
// texel: R holds the whole part, G the fraction.
#ifdef GL_FRAGMENT_PRECISION_HIGH
#define FULL highp
#else
#define FULL mediump
#endif
uniform FULL sampler2D Density;
uniform sampler2D sWaterTexture;
uniform sampler2D sBGTexture;
uniform float alphaRatio1;
uniform FULL float intensity;
uniform float fresnelRatio;
uniform float specularRatio;
uniform float exponent;
uniform FULL vec2 Scale;
uniform FULL vec3 ink_color;
varying vec2 vWaterTextureCoord;
varying FULL vec2 vBGTexture1Coord;
varying vec3 vNormal;
varying vec3 vHalfVec;
varying float vHeights;

void main() {
    vec4 waterColor = texture2D(sWaterTexture, vWaterTextureCoord);
    vec4 bgColor = texture2D(sBGTexture, vBGTexture1Coord);
    float NdotHV = max(dot(vNormal, vHalfVec), 0.0);
    float specular = clamp(specularRatio * pow(NdotHV, exponent), 1.0, 4.5);
    float NdotL = max(dot(vNormal, vec3(5.0, -5.0, 1.0)), 0.0);
    float t = clamp(abs(vHeights), 0.0, 1.13);
    float fresnel = alphaRatio1 + fresnelRatio * clamp(NdotL - 0.99, 0.0, 0.3);
    vec3 rippleRGB = t * specular * waterColor.rgb * fresnel + bgColor.rgb;

    FULL vec4 buf = texture2D(Density, gl_FragCoord.xy * Scale);
    FULL float density = 255.0 * buf.x + buf.y;
    FULL float w = intensity * density;
    gl_FragColor = vec4(rippleRGB / (1.0 + w * ink_color), 1.0);
}
