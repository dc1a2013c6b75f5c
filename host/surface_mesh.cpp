#include "host/surface_mesh.h"

#include <algorithm>
#include <cstddef>
#include <cstring>

#include "base/float4.h"

namespace tidemark {

namespace {

// Rows and columns are computed in groups of four.
constexpr int kGroup = 4;

// Number of lattice columns in the buffers: a vertex needs five, and they are read in groups.
constexpr int kKept = 8;

// Number of rows above a vertex's cell that are read. Beyond the edge they repeat the edge's height.
constexpr int kAbove = 2;

typedef unsigned short ushort8 __attribute__((vector_size(16)));

std::ptrdiff_t at(int line, int length) {
    return std::ptrdiff_t{line} * length;
}

int padded(int count) {
    return (count + kGroup - 1) / kGroup * kGroup;
}

std::vector<float> field(int lines, int length) {
    return std::vector<float>(static_cast<std::size_t>(at(lines, length)));
}

// Transposes a block of four rows.
inline void turn(float4 (&lines)[kGroup]) {
    const float4 firstTop = __builtin_shufflevector(lines[0], lines[1], 0, 4, 1, 5);
    const float4 lastTop = __builtin_shufflevector(lines[0], lines[1], 2, 6, 3, 7);
    const float4 firstBottom = __builtin_shufflevector(lines[2], lines[3], 0, 4, 1, 5);
    const float4 lastBottom = __builtin_shufflevector(lines[2], lines[3], 2, 6, 3, 7);
    lines[0] = __builtin_shufflevector(firstTop, firstBottom, 0, 1, 4, 5);
    lines[1] = __builtin_shufflevector(firstTop, firstBottom, 2, 3, 6, 7);
    lines[2] = __builtin_shufflevector(lastTop, lastBottom, 0, 1, 4, 5);
    lines[3] = __builtin_shufflevector(lastTop, lastBottom, 2, 3, 6, 7);
}

inline float4 everywhere(float value) {
    return float4{value, value, value, value};
}

struct Weights {
    explicit Weights(const float (&w)[4])
        : a(everywhere(w[0])), b(everywhere(w[1])), c(everywhere(w[2])), d(everywhere(w[3])) {}
    float4 a, b, c, d;
};

inline float4 blend(const Weights& w, float4 a, float4 b, float4 c, float4 d) {
    return w.a * a + w.b * b + w.c * c + w.d * d;
}

// Writes three values for each of four vertices, and one more value.
inline void interleave(float4 a, float4 b, float4 c, float* out) {
    const float4 firstTwo = __builtin_shufflevector(a, b, 0, 4, 1, 5);
    const float4 lastTwo = __builtin_shufflevector(a, b, 2, 6, 3, 7);
    store(__builtin_shufflevector(firstTwo, c, 0, 1, 4, 4), out);
    store(__builtin_shufflevector(firstTwo, c, 2, 3, 5, 5), out + 3);
    store(__builtin_shufflevector(lastTwo, c, 0, 1, 6, 6), out + 6);
    store(__builtin_shufflevector(lastTwo, c, 2, 3, 7, 7), out + 9);
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
    // Includes two cells before and three after, which the spline and the slopes need.
    axis.from = std::max(axis.places.front().cell - 2, 0);
    axis.points = std::min(axis.places.back().cell + 4, points) - axis.from;
    for (Place& place : axis.places) place.cell -= axis.from;
    return axis;
}

SurfaceMesh::SurfaceMesh(int points, int vertices, double width, double height)
    : points_(points), columns_(axis(points, vertices, width)), rows_(axis(points, vertices, height)) {
    const int column = padded(rows_.points);
    const int rows = padded(rows_.seen.count);
    rows_.places.resize(static_cast<std::size_t>(rows), rows_.places.back());
    read_ = field(kGroup, column);
    readRows_ = field(kAbove + column + 1, kGroup);
    own_ = upper_ = field(kKept, rows);
    lastColumn_ = field(1, 3 * rows + 1);
    slopes_ = slopesBefore_ = field(1, rows + 1);
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

// Reads four columns of the lattice. Beyond the edge the last column is repeated.
void SurfaceMesh::readColumns(
    int first, const float* heights, const float* velocity, float since, const Breeze* breeze) {
    const int points = rows_.points;
    const int length = padded(points);
    for (int k = 0; k < kGroup; ++k) {
        const int column = columns_.from + std::min(first + k, columns_.points - 1);
        const float* const h = heights + at(column, points_) + rows_.from;
        const float* const v = velocity + at(column, points_) + rows_.from;
        float* const __restrict line = read_.data() + at(k, length);
        for (int i = 0; i < points; ++i) line[i] = h[i] + since * v[i];
        if (breeze) breeze->add(column, rows_.from, points, line);
    }
    float* const rows = readRows_.data() + kAbove * kGroup;
    for (int i = 0; i < points; i += kGroup) {
        float4 lines[kGroup];
        for (int k = 0; k < kGroup; ++k) lines[k] = load<float4>(read_.data() + at(k, length) + i);
        turn(lines);
        for (int k = 0; k < kGroup; ++k) store(lines[k], rows + (i + k) * kGroup);
    }
    for (int i = 1; i <= kAbove; ++i) std::copy_n(rows, kGroup, rows - i * kGroup);
    std::copy_n(rows + (points - 1) * kGroup, kGroup, rows + points * kGroup);
}

// Interpolates the four columns along their length, at the rows of the mesh.
void SurfaceMesh::blendRows(int first) {
    const int rows = padded(rows_.seen.count);
    float* const own = own_.data() + at(first % kKept, rows);
    float* const upper = upper_.data() + at(first % kKept, rows);
    const float* const readRows = readRows_.data();
    const Place* const places = rows_.places.data();
    for (int r = 0; r < rows; r += kGroup) {
        float4 owns[kGroup], uppers[kGroup];
        for (int k = 0; k < kGroup; ++k) {
            const Place& place = places[r + k];
            const float* const around = readRows + place.cell * kGroup;  // from two cells above
            const float4 a = load<float4>(around);
            const float4 b = load<float4>(around + kGroup);
            const float4 c = load<float4>(around + 2 * kGroup);
            const float4 d = load<float4>(around + 3 * kGroup);
            const Weights weights(place.weights);
            owns[k] = blend(weights, b, c, d, load<float4>(around + 4 * kGroup));
            uppers[k] = blend(weights, a, b, c, d);
        }
        turn(owns);
        turn(uppers);
        for (int k = 0; k < kGroup; ++k) {
            store(owns[k], own + k * rows + r);
            store(uppers[k], upper + k * rows + r);
        }
    }
}

// Interpolates one column of the mesh. Writes one value beyond the column's padding.
void SurfaceMesh::blendColumn(const Place& place, float* attribs) {
    const int rows = padded(rows_.seen.count);
    const auto line = [&](const std::vector<float>& lines, int i) {
        return lines.data() + at(std::clamp(place.cell + i, 0, columns_.points - 1) % kKept, rows);
    };
    const float* const own[] = {line(own_, -1), line(own_, 0), line(own_, 1), line(own_, 2), line(own_, 3)};
    const float* const upper[] = {line(upper_, -1), line(upper_, 0), line(upper_, 1), line(upper_, 2)};
    const Weights weights(place.weights);
    float* const slopes = slopes_.data();
    for (int r = 0; r < rows; r += kGroup) {
        const float4 b = load<float4>(own[1] + r);
        const float4 c = load<float4>(own[2] + r);
        const float4 d = load<float4>(own[3] + r);
        const float4 height = blend(weights, load<float4>(own[0] + r), b, c, d);
        const float4 toTheRight = blend(weights, b, c, d, load<float4>(own[4] + r));
        const float4 above = blend(
            weights, load<float4>(upper[0] + r), load<float4>(upper[1] + r), load<float4>(upper[2] + r),
            load<float4>(upper[3] + r));
        store((height - toTheRight) * (height - above), slopes + r);
        interleave(height, toTheRight, above, attribs + 3 * r);
    }
}

// Chooses the diagonals of the cells between this column of the mesh and the previous one. The diagonal determines the
// third and fourth index of a cell. All are written, because a branch on a change would be mispredicted too often.
void SurfaceMesh::turnDiagonals(int column, std::int16_t* indices) {
    const int rows = rows_.seen.count;
    const int cells = rows - 1;
    const float* const left = slopesBefore_.data();
    const float* const right = slopes_.data();
    const auto topRight = static_cast<unsigned short>(column * rows);
    const auto topLeft = static_cast<unsigned short>(topRight - rows);
    ushort8 level = ushort8{topRight, topLeft, topRight, topLeft, topRight, topLeft, topRight, topLeft} +
                    ushort8{1, 0, 2, 1, 3, 2, 4, 3};
    const auto pairs = [=, &level](int r) {
        const float4 sum =
            load<float4>(left + r) + load<float4>(left + r + 1) + load<float4>(right + r) + load<float4>(right + r + 1);
        const auto isTurned = reinterpret_cast<ushort8>(reinterpret_cast<int4>(sum) >> 31);
        const ushort8 values = level + (isTurned & ushort8{0xffff, 1, 0xffff, 1, 0xffff, 1, 0xffff, 1});
        level += ushort8{4, 4, 4, 4, 4, 4, 4, 4};
        return values;
    };
    std::int16_t* const cell = indices + 6 * at(column - 1, cells) + 2;
    const auto write = [=](const ushort8& values, int r, int k) {
        std::memcpy(cell + 6 * (r + k), reinterpret_cast<const char*>(&values) + 4 * k, 4);
    };
    int r = 0;
    for (; r + kGroup <= cells; r += kGroup) {
        const ushort8 values = pairs(r);
        for (int k = 0; k < kGroup; ++k) write(values, r, k);
    }
    const ushort8 values = pairs(r);
    for (int k = 0; k < cells - r; ++k) write(values, r, k);
}

void SurfaceMesh::gather(
    const float* heights, const float* velocity, float since, float* attribs, std::int16_t* indices,
    const Breeze* breeze) {
    const int rows = rows_.seen.count;
    const float* const end = attribs + at(columns_.seen.count, 3 * rows);
    int read = 0;
    for (int c = 0; c < columns_.seen.count; ++c, attribs += 3 * rows) {
        const Place& place = columns_.places[static_cast<std::size_t>(c)];
        for (const int needed = std::min(place.cell + 4, columns_.points); read < needed; read += kGroup) {
            readColumns(read, heights, velocity, since, breeze);
            blendRows(read);
        }
        slopes_.swap(slopesBefore_);
        // The next column overwrites this column's padding.
        if (end - attribs >= static_cast<std::ptrdiff_t>(lastColumn_.size())) {
            blendColumn(place, attribs);
        } else {
            blendColumn(place, lastColumn_.data());
            std::copy_n(lastColumn_.data(), 3 * rows, attribs);
        }
        if (c > 0) turnDiagonals(c, indices);
    }
}

}  // namespace tidemark
