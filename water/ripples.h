#pragma once

// A field of one value per vertex, centred on (0, 0), extentA x extentB units of the host. A is the fast axis.
struct RippleField {
    float* values;  // countA * countB floats, addressed as b * countA + a
    int extentA;
    int extentB;
    int countA;
    int countB;
};

// Adds a cone with a radius of three cells and a peak of 3 * amplitude at (posA, posB). Never writes the cells 0, 1 and
// count - 1 of either axis, so any centre is safe, including NaN.
void addRipple(const RippleField& field, float posA, float posB, float amplitude);
