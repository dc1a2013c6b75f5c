// Draws the water: the picture behind it seen through its slopes, light on its waves, and ink in it.
#pragma once

#include <GLES2/gl2.h>

// GL names of the water program of a set-up, of the three buffers that each frame fills, and of the pictures.
struct WaterObjects {
    GLuint program;
    GLuint positions;
    GLuint heights;
    GLuint indices;
    GLuint background;
    GLuint light;
};

struct WaterMesh {
    const float* positions;      // 3 a vertex
    const float* heightAttribs;  // 3 a vertex
    const short* indices;        // unsigned vertex numbers, 3 a triangle
    int positionFloats;
    int heightFloats;
    int indexCount;
    const float* mvp;  // 16, by columns
    int sizeWidth;     // extent in model units
    int sizeHeight;
    int detailsWidth;  // vertices a side
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
    GLuint density;  // texture, two bytes a value
    float tint[3];   // what a unit of density adds to the divisor of a channel
    float intensity;
};

// Draws into the current framebuffer, over a view of viewWidth x viewHeight pixels. Without `ink` the program must be
// the plain one. Leaves the program in use, the buffers of positions and indices bound and texture units 0 to 3
// unbound.
void drawWater(
    const WaterObjects& objects, int viewWidth, int viewHeight, const WaterMesh& mesh, const WaterLight& light,
    const WaterInk* ink);
