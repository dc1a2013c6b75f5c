#include "host/surface_mesh.h"

#include <algorithm>
#include <cstddef>

namespace {

std::size_t product(int a, int b) {
    return static_cast<std::size_t>(a) * static_cast<std::size_t>(b);
}

// One column of the mesh from four of the lattice.
void blend(
    const float* weights, const float* a, const float* b, const float* c, const float* d, int count,
    float* __restrict out) {
    const float wa = weights[0];
    const float wb = weights[1];
    const float wc = weights[2];
    const float wd = weights[3];
    for (int i = 0; i < count; ++i) out[i] = wa * a[i] + wb * b[i] + wc * c[i] + wd * d[i];
}

}  // namespace

SurfaceMesh::SurfaceMesh(int points, int vertices)
    : points_(points),
      vertices_(vertices),
      column_(static_cast<std::size_t>(points) + 4),
      own_(product(points, vertices)),
      upper_(product(points, vertices)),
      heights_(static_cast<std::size_t>(vertices)),
      rights_(static_cast<std::size_t>(vertices)),
      uppers_(static_cast<std::size_t>(vertices)) {
    for (int i = 0; i < vertices; ++i) {
        const double place = static_cast<double>(i) * (points - 1) / (vertices - 1);
        const int cell = std::min(static_cast<int>(place), points - 2);
        const auto t = static_cast<float>(place - cell);
        places_.push_back(
            {cell,
             {(1.0f - t) * (1.0f - t) * (1.0f - t) / 6.0f, ((3.0f * t - 6.0f) * t * t + 4.0f) / 6.0f,
              (((3.0f - 3.0f * t) * t + 3.0f) * t + 1.0f) / 6.0f, t * t * t / 6.0f}});
    }
}

const float* SurfaceMesh::row(const std::vector<float>& of, int column) const {
    return of.data() + product(std::clamp(column, 0, points_ - 1), vertices_);
}

void SurfaceMesh::gather(const float* heights, float* attribs) {
    for (int c = 0; c < points_; ++c) {
        const float* const column = heights + product(c, points_);
        std::copy_n(column, points_, column_.begin() + 2);
        column_[0] = column_[1] = column[0];
        column_[column_.size() - 2] = column_[column_.size() - 1] = column[points_ - 1];
        float* const own = own_.data() + product(c, vertices_);
        float* const upper = upper_.data() + product(c, vertices_);
        for (int r = 0; r < vertices_; ++r) {
            const Place& p = places_[static_cast<std::size_t>(r)];
            const float* const h = column_.data() + p.cell;
            own[r] = p.weights[0] * h[1] + p.weights[1] * h[2] + p.weights[2] * h[3] + p.weights[3] * h[4];
            upper[r] = p.weights[0] * h[0] + p.weights[1] * h[1] + p.weights[2] * h[2] + p.weights[3] * h[3];
        }
    }
    for (const Place& p : places_) {
        const auto across = [&](const std::vector<float>& from, int shift, std::vector<float>& to) {
            const int c = p.cell + shift;
            blend(p.weights, row(from, c - 1), row(from, c), row(from, c + 1), row(from, c + 2), vertices_, to.data());
        };
        across(own_, 0, heights_);
        across(own_, 1, rights_);
        across(upper_, 0, uppers_);
        for (std::size_t r = 0; r < heights_.size(); ++r, attribs += 3) {
            attribs[0] = heights_[r];
            attribs[1] = rights_[r];
            attribs[2] = uppers_[r];
        }
    }
}
