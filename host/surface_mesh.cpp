#include "host/surface_mesh.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace tidemark {

namespace {

std::ptrdiff_t at(int line, int length) {
    return std::ptrdiff_t{line} * length;
}

// Lines are turned in groups of four.
int padded(int lines) {
    return (lines + 3) / 4 * 4;
}

std::vector<float> field(int lines, int length) {
    return std::vector<float>(static_cast<std::size_t>(at(lines, length)));
}

void advance(const float* heights, const float* velocity, float since, int count, float* __restrict out) {
    for (int i = 0; i < count; ++i) out[i] = heights[i] + since * velocity[i];
}

// Makes columns of rows, or rows of columns.
void turn(const float* __restrict in, int lines, int length, float* __restrict out) {
    for (int line = 0; line < lines; line += 4) {
        for (int i = 0; i < length; ++i) {
            for (int k = 0; k < 4; ++k) out[at(i, lines) + line + k] = in[at(line + k, length) + i];
        }
    }
}

// One line of values between the lines `cell` and `cell` + 1; beyond the edge the last line goes on.
void blend(const std::vector<float>& lines, int length, int cell, const float* weights, float* __restrict out) {
    const int last = static_cast<int>(lines.size()) / length - 1;
    const auto line = [&](int i) { return lines.data() + at(std::clamp(i, 0, last), length); };
    const float* const a = line(cell - 1);
    const float* const b = line(cell);
    const float* const c = line(cell + 1);
    const float* const d = line(cell + 2);
    const float wa = weights[0];
    const float wb = weights[1];
    const float wc = weights[2];
    const float wd = weights[3];
    for (int i = 0; i < length; ++i) out[i] = wa * a[i] + wb * b[i] + wc * c[i] + wd * d[i];
}

void interleave(
    const float* __restrict a, const float* __restrict b, const float* __restrict c, int count, float* __restrict out) {
    for (int i = 0; i < count; ++i) {
        out[3 * i] = a[i];
        out[3 * i + 1] = b[i];
        out[3 * i + 2] = c[i];
    }
}

// The product of both slopes of each vertex.
void multiplySlopes(
    const float* __restrict h, const float* __restrict right, const float* __restrict upper, int count,
    float* __restrict out) {
    for (int i = 0; i < count; ++i) out[i] = (h[i] - right[i]) * (h[i] - upper[i]);
}

// Of each cell between two columns: 1 where its waves run to the lower right or the upper left, else 0.
void compareSlopes(const float* __restrict left, const float* __restrict right, int count, int* __restrict out) {
    for (int i = 0; i < count; ++i) out[i] = std::signbit(left[i] + left[i + 1] + right[i] + right[i + 1]);
}

}  // namespace

SurfaceMesh::Axis SurfaceMesh::axis(int points, int vertices, double share) {
    const int first = std::max(static_cast<int>((vertices - 1) * (1.0 - share) / 2), 0);
    Axis axis = {{first, vertices - 2 * first}, 0, 0, {}};
    for (int i = first; i < vertices - first; ++i) {
        const double place = static_cast<double>(i) * (points - 1) / (vertices - 1);
        const int cell = std::min(static_cast<int>(place), points - 2);
        const auto t = static_cast<float>(place - cell);
        axis.places.push_back(
            {cell,
             {(1.0f - t) * (1.0f - t) * (1.0f - t) / 6.0f, ((3.0f * t - 6.0f) * t * t + 4.0f) / 6.0f,
              (((3.0f - 3.0f * t) * t + 3.0f) * t + 1.0f) / 6.0f, t * t * t / 6.0f}});
    }
    // With the neighbours two cells before and three behind.
    axis.from = std::max(axis.places.front().cell - 2, 0);
    axis.points = std::min(axis.places.back().cell + 4, points) - axis.from;
    for (Place& place : axis.places) place.cell -= axis.from;
    return axis;
}

SurfaceMesh::SurfaceMesh(int points, int vertices, double width, double height)
    : points_(points), columns_(axis(points, vertices, width)), rows_(axis(points, vertices, height)) {
    const int columns = padded(columns_.points);
    const int rows = padded(rows_.seen.count);
    lattice_ = field(columns, rows_.points);
    latticeRows_ = field(rows_.points, columns);
    ownRows_ = upperRows_ = field(rows, columns);
    own_ = upper_ = field(columns, rows);
    heights_ = rights_ = uppers_ = slopes_ = slopesBefore_ = field(1, rows);
    turned_.resize(heights_.size());
}

void SurfaceMesh::layCells(std::int16_t* indices) const {
    const int rows = rows_.seen.count;
    for (int c = 0; c < columns_.seen.count - 1; ++c) {
        for (int r = 0; r < rows - 1; ++r) {
            const int topLeft = c * rows + r;
            const int topRight = topLeft + rows;
            for (const int i : {topLeft, topLeft + 1, topRight + 1, topLeft, topRight + 1, topRight}) {
                *indices++ = static_cast<std::int16_t>(i);
            }
        }
    }
}

// Chooses the diagonals of the cells that end at a column of the mesh.
void SurfaceMesh::turnDiagonals(int column, std::int16_t* indices) {
    const int rows = rows_.seen.count;
    const int cells = rows - 1;
    slopes_.swap(slopesBefore_);
    multiplySlopes(heights_.data(), rights_.data(), uppers_.data(), rows, slopes_.data());
    if (column == 0) return;
    compareSlopes(slopesBefore_.data(), slopes_.data(), cells, turned_.data());
    std::int16_t* cell = indices + 6 * at(column - 1, cells);
    int topRight = column * rows;
    for (int r = 0; r < cells; ++r, ++topRight, cell += 6) {
        const int turned = turned_[static_cast<std::size_t>(r)];
        cell[2] = static_cast<std::int16_t>(topRight + 1 - turned);
        cell[3] = static_cast<std::int16_t>(topRight - rows + turned);
    }
}

void SurfaceMesh::gather(
    const float* heights, const float* velocity, float since, float* attribs, std::int16_t* indices,
    const Breeze* breeze) {
    const int columns = padded(columns_.points);
    const int rows = padded(rows_.seen.count);
    for (int c = 0; c < columns; ++c) {
        const int column = columns_.from + std::min(c, columns_.points - 1);
        const auto first = at(column, points_) + rows_.from;
        float* const line = lattice_.data() + at(c, rows_.points);
        advance(heights + first, velocity + first, since, rows_.points, line);
        if (breeze) breeze->add(column, rows_.from, rows_.points, line);
    }
    turn(lattice_.data(), columns, rows_.points, latticeRows_.data());
    for (int r = 0; r < rows_.seen.count; ++r) {
        const Place& p = rows_.places[static_cast<std::size_t>(r)];
        blend(latticeRows_, columns, p.cell, p.weights, ownRows_.data() + at(r, columns));
        blend(latticeRows_, columns, p.cell - 1, p.weights, upperRows_.data() + at(r, columns));
    }
    turn(ownRows_.data(), rows, columns, own_.data());
    turn(upperRows_.data(), rows, columns, upper_.data());
    for (int c = 0; c < columns_.seen.count; ++c) {
        const Place& p = columns_.places[static_cast<std::size_t>(c)];
        blend(own_, rows, p.cell, p.weights, heights_.data());
        blend(own_, rows, p.cell + 1, p.weights, rights_.data());
        blend(upper_, rows, p.cell, p.weights, uppers_.data());
        interleave(heights_.data(), rights_.data(), uppers_.data(), rows_.seen.count, attribs);
        attribs += at(3, rows_.seen.count);
        turnDiagonals(c, indices);
    }
}

}  // namespace tidemark
