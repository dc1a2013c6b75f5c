// The drawn mesh. Its heights are sampled from a smooth surface near the lattice's heights, so that the mesh can be
// finer than the lattice and change its size without a visible jump.
#pragma once

#include <cstdint>
#include <vector>

#include "host/breeze.h"

namespace tidemark {

class SurfaceMesh {
public:
    // A square of vertices x vertices over a lattice of points x points, each at least 2. Only the middle is drawn:
    // `width` and `height` are its shares of a side, above 0.
    SurfaceMesh(int points, int vertices, double width, double height);

    // The range of drawn vertices along an axis.
    struct Seen {
        int first, count;
    };
    Seen columns() const { return columns_.seen; }
    Seen rows() const { return rows_.seen; }

    // Writes the indices of the two triangles of each drawn cell, column by column: 6 * (columns - 1) * (rows - 1).
    void layCells(std::int16_t* indices) const;

    // Writes three values for each drawn vertex, column by column from the left, each column from the top: the height,
    // and the heights one lattice cell to the right and one above, from which the renderer computes the slope. Beyond
    // the edge the surface is level. The surface is a bicubic B-spline (de Boor, A practical guide to splines, 1978),
    // whose slopes are smooth; an interpolating surface would show the lattice in every crest.
    //
    // Also turns the diagonal of each cell along its waves, because a diagonal across a crest gives it a jagged edge.
    // The direction of the waves is the sign of the structure tensor's mixed element (Bigun and Granlund, Optimal
    // orientation detection of linear symmetry, 1987).
    //
    // `heights` and `velocity` have points * points values: the heights at a step and their change per step. `since` is
    // the time after that step, in steps. `attribs` receives 3 values per vertex. `indices` are those written by
    // layCells(). `breeze` is added to the heights; it may be null.
    void gather(
        const float* heights, const float* velocity, float since, float* attribs, std::int16_t* indices,
        const Breeze* breeze = nullptr);

private:
    // The position of a vertex along an axis: between the read points `cell` and `cell` + 1, with the weights of the
    // four points around it.
    struct Place {
        int cell;
        float weights[4];
    };
    struct Axis {
        Seen seen;
        int from, points;           // range of lattice points that are read
        std::vector<Place> places;  // positions of the drawn vertices
    };
    static Axis axis(int points, int vertices, double share);
    void readColumns(int first, const float* heights, const float* velocity, float since, const Breeze* breeze);
    void blendRows(int first);
    void blendColumn(const Place& place, float* attribs);
    void turnDiagonals(int column, std::int16_t* indices);

    int points_;
    Axis columns_, rows_;
    std::vector<float> read_;         // four columns of the lattice at the current time
    std::vector<float> readRows_;     // the same, row by row
    std::vector<float> own_, upper_;  // the latest columns at the rows of the mesh, and one cell above these rows
    std::vector<float> lastColumn_;   // last column of the mesh
    std::vector<float> slopes_, slopesBefore_;  // product of both slopes in this column and the previous one
};

}  // namespace tidemark
