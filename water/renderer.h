// Draws the water: the background refracted by its slopes, highlights on the waves, and the ink.
#pragma once

#include <GLES2/gl2.h>

// GL names.
struct WaterObjects {
    GLuint program;
    GLuint positions;  // buffers, filled by each frame
    GLuint heights;
    GLuint indices;
    GLuint background;  // textures
    GLuint light;
};

struct WaterMesh {
    const float* positions;      // 3 per vertex
    const float* heightAttribs;  // 3 per vertex
    const short* indices;        // unsigned vertex numbers, 3 per triangle
    int positionFloats;
    int heightFloats;
    int indexCount;
    const float* mvp;  // 16, column-major
    int sizeWidth;     // extent in model units
    int sizeHeight;
    int detailsWidth;  // vertices along each axis
    int detailsHeight;
};

struct WaterLight {
    float refractiveIndex;
    float alphaMix;
    float alphaScale1;
    float alphaScale2;
    float fresnelRatio;
    float specularRatio;
    float exponent;
};

struct WaterInk {
    GLuint density;  // texture, two bytes per value
    float tint[3];   // the colour is divided by 1 + intensity * density * tint
    float intensity;
};

// Draws into the current framebuffer, over a view of viewWidth x viewHeight pixels. `objects.program` must be the ink
// program if `ink` is not null, else the plain one. Leaves the program in use, the buffers of positions and indices
// bound and texture units 0 to 3 unbound.
void drawWater(
    const WaterObjects& objects, int viewWidth, int viewHeight, const WaterMesh& mesh, const WaterLight& light,
    const WaterInk* ink);
