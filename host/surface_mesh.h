// The mesh that is drawn. It takes its heights from a smooth surface near those of the lattice, so that it may be
// finer than the waves, and change without a jump.
#pragma once

#include <cstdint>
#include <vector>

#include "host/breeze.h"

namespace tidemark {

class SurfaceMesh {
public:
    // A square of `vertices` a side over a lattice of `points` a side, each at least 2, of which only a middle part is
    // seen: `width` and `height` are its shares of a side, above 0.
    SurfaceMesh(int points, int vertices, double width, double height);

    // The vertices along an axis that what is seen takes.
    struct Seen {
        int first, count;
    };
    Seen columns() const { return columns_.seen; }
    Seen rows() const { return rows_.seen; }

    // The two triangles of each cell that is seen, column by column: 6 * (columns - 1) * (rows - 1) vertices.
    void layCells(std::int16_t* indices) const;

    // For each vertex that is seen, column by column from the left and each column from the top: its height, and the
    // heights one cell of the lattice to the right and above, of which the renderer takes the slope. Beyond the edge
    // the surface goes on level. A bicubic B-spline (de Boor, A practical guide to splines, 1978): its slopes bend
    // smoothly, where a surface through the very heights would show the lattice in every crest.
    //
    // Also turns the diagonal of each cell along its waves, as one across would cut a crest into teeth. Which way they
    // run is the sign of the mixed element of the structure tensor (Bigun and Granlund, Optimal orientation detection
    // of linear symmetry, 1987).
    //
    // `heights`, `velocity`: points * points values in the same order, and what each gains a step; `since`: steps
    // passed since then; `attribs`: 3 values a vertex; `indices`: those that layCells() has laid; `breeze`: is added to
    // the heights.
    void gather(
        const float* heights, const float* velocity, float since, float* attribs, std::int16_t* indices,
        const Breeze* breeze = nullptr);

private:
    // Where a vertex lies along an axis: between points `cell` and `cell` + 1 of those that are read. The weights are
    // those of the four points around it.
    struct Place {
        int cell;
        float weights[4];
    };
    struct Axis {
        Seen seen;
        int from, points;           // of the lattice, that are read
        std::vector<Place> places;  // of the vertices that are seen
    };
    static Axis axis(int points, int vertices, double share);
    void readColumns(int first, const float* heights, const float* velocity, float since, const Breeze* breeze);
    void blendRows(int first);
    void blendColumn(const Place& place, float* attribs);
    void turnDiagonals(int column, std::int16_t* indices);

    int points_;
    Axis columns_, rows_;
    std::vector<float> read_;                   // four columns of the lattice, as it is at that time
    std::vector<float> readRows_;               // row by row
    std::vector<float> own_, upper_;            // its last columns at the mesh's rows, and one cell above them
    std::vector<float> lastColumn_;             // of the mesh
    std::vector<float> slopes_, slopesBefore_;  // the products of both slopes in this column and in the one before
};

}  // namespace tidemark
