// The mesh that is drawn. It takes its heights from a smooth surface near those of the lattice, so that it may be
// finer than the waves, and change without a jump.
#pragma once

#include <vector>

class SurfaceMesh {
public:
    // `vertices` a side, over a lattice of `points` a side; each at least 2.
    SurfaceMesh(int points, int vertices);

    // For each vertex, column by column from the left and each column from the top: its height, and the heights one
    // cell of the lattice to the right and above, of which the renderer takes the slope. Beyond the edge the surface
    // goes on level. `heights`: points * points values in the same order; `attribs`: 3 * vertices * vertices.
    // A bicubic B-spline (de Boor, A practical guide to splines, 1978): its slopes bend smoothly, where a surface
    // through the very heights would show the lattice in every crest.
    void gather(const float* heights, float* attribs);

private:
    // Where a vertex lies along an axis: between points `cell` and `cell` + 1. The weights are those of the four points
    // around it.
    struct Place {
        int cell;
        float weights[4];
    };

    const float* row(const std::vector<float>& of, int column) const;

    int points_;
    int vertices_;
    std::vector<Place> places_;
    std::vector<float> column_;                     // of the lattice, with two points more at either end
    std::vector<float> own_;                        // the lattice's columns at the mesh's rows
    std::vector<float> upper_;                      // one cell above them
    std::vector<float> heights_, rights_, uppers_;  // a column of the mesh
};
