// Impulses that disturb the water.
#pragma once

// A field of one value per vertex: countA values along the fast axis, countB along the slow one, spanning
// extentA x extentB of the host's units around its middle.
struct RippleField {
    float* values;  // countA * countB floats, addressed as b * countA + a
    int extentA;
    int extentB;
    int countA;
    int countB;
};

// Adds a cone with a radius of three cells and a peak of 3 * amplitude at (posA, posB), measured from the middle.
// Cells 0, 1 and count - 1 of either axis are never touched, so any centre, even one that is not a number, is safe.
void addRipple(const RippleField& field, float posA, float posB, float amplitude);
