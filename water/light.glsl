uniform sampler2D sWaterTexture;
uniform sampler2D sBGTexture;
uniform float alphaRatio1;
uniform float fresnelRatio;
uniform float specularRatio;
uniform float exponent;
varying vec2 vWaterTextureCoord;
varying FULL vec2 vBGTexture1Coord;
varying vec3 vNormal;
varying vec3 vHalfVec;
varying float vHeights;

// Returns the refracted background with the light on the waves added; highlights are clamped to `brightest`.
vec3 litWater(float brightest) {
    vec4 waterColor = texture2D(sWaterTexture, vWaterTextureCoord);
    vec4 bgColor = texture2D(sBGTexture, vBGTexture1Coord);
    float NdotHV = max(dot(vNormal, vHalfVec), 0.0);
    float specular = clamp(specularRatio * pow(NdotHV, exponent), 1.0, brightest);
    float NdotL = max(dot(vNormal, vec3(5.0, -5.0, 1.0)), 0.0);
    float t = clamp(abs(vHeights), 0.0, 1.13);
    float fresnel = alphaRatio1 + fresnelRatio * clamp(NdotL - 0.99, 0.0, 0.3);
    return t * specular * waterColor.rgb * fresnel + bgColor.rgb;
}
