// Refracts the view ray of each vertex by the slope of the water and intersects it with the background. In model space
// the eye is at z = -30, the water at z = 0 and the background in the plane z = 30.9.
uniform mat4 uMVPMatrix;
uniform float uMESH_SIZE_WIDTH;
uniform float uMESH_SIZE_HEIGHT;
uniform float uNUM_DETAILS_WIDTH;  // by contract declared, but not used
uniform float uNUM_DETAILS_HEIGHT;
uniform float uRefractiveIndex;
attribute vec4 aPosition;
attribute vec4 aHeights;  // heights of the vertex, of its neighbour in x and of its neighbour in y
varying vec2 vWaterTextureCoord;
varying vec2 vBGTexture1Coord;
varying vec3 vNormal;
varying vec3 vHalfVec;
varying float vHeights;

void main() {
    float maxX = uMESH_SIZE_WIDTH / 2.0;
    float maxY = uMESH_SIZE_HEIGHT / 2.0;
    float rimo = uRefractiveIndex - 1.0;

    float h = aHeights.x;
    vec3 surface = vec3(aPosition.xy, h * 0.25);
    vec2 slope = vec2(h - aHeights.y, h - aHeights.z) * 0.25;
    slope /= sqrt(dot(slope, slope) + 1.0);

    vec3 ray = normalize(vec3(surface.xy, surface.z + 30.0));
    float bend = dot(ray, vec3(slope, 1.0)) * rimo;
    ray.xy += slope * bend;

    float reach = (30.9 - surface.z) / ray.z;
    vec2 hit = ray.xy * reach + surface.xy;
    // The picture's first row is its top, so t increases downwards and y upwards.
    vBGTexture1Coord = vec2(hit.x / maxX * 0.25 + 0.5, hit.y / maxY * -0.25 + 0.5);
    // By contract y is divided by the width and x by the height.
    vWaterTextureCoord = slope * 0.5 + 0.5 + vec2(aPosition.y / uMESH_SIZE_WIDTH, aPosition.x / uMESH_SIZE_HEIGHT) * 0.25;

    vec4 position = uMVPMatrix * aPosition;
    // By contract a transformed point, not a normalized direction.
    vec3 light = (uMVPMatrix * vec4(5.0, -5.0, 1.0, 1.0)).xyz;
    vNormal = normalize(vec3(slope, 0.6));
    vHalfVec = normalize(normalize(vec3(0.0, 0.0, 1.0) - position.xyz) + light);
    vHeights = h;
    gl_Position = position;  // by contract flat: the heights affect only refraction and light
}
