// The water's shaders in plain C++, for one pixel of a mesh that an axis-aligned transform lays over the view.
#pragma once

#include <algorithm>
#include <array>
#include <cmath>
#include <vector>

#include "host/picture.h"

namespace reference {

using Vec3 = std::array<double, 3>;

inline double dot(const Vec3& a, const Vec3& b) {
    return a[0] * b[0] + a[1] * b[1] + a[2] * b[2];
}

inline Vec3 normalized(const Vec3& v) {
    const double length = std::sqrt(dot(v, v));
    return {v[0] / length, v[1] / length, v[2] / length};
}

struct Scene {
    int n;                       // vertices a side
    double width, height;        // of the mesh, model units
    double scaleX, scaleY;       // model units to clip space
    std::vector<float> heights;  // column by column, each from the top
    double refractiveIndex, alphaRatio1, fresnelRatio, specularRatio, exponent, specularLimit;
    const Picture* background;
    const Picture* water;
};

// What a vertex hands to the pixels.
struct Varyings {
    double values[11];
};

inline Varyings vertex(const Scene& s, int column, int row) {
    const auto heightAt = [&s](int c, int r) { return double{s.heights[static_cast<std::size_t>(c * s.n + r)]}; };
    const double x = column * s.width / (s.n - 1) - s.width / 2;
    const double y = s.height / 2 - row * s.height / (s.n - 1);
    const double h = heightAt(column, row);
    double nx = (h - heightAt(std::min(column + 1, s.n - 1), row)) * 0.25;
    double ny = (h - heightAt(column, std::max(row - 1, 0))) * 0.25;
    const double nz = std::sqrt(nx * nx + ny * ny + 1);
    nx /= nz;
    ny /= nz;
    Vec3 d = normalized({x, y, h * 0.25 + 30});
    const double t = (d[0] * nx + d[1] * ny + d[2]) * (s.refractiveIndex - 1);
    d[0] += nx * t;
    d[1] += ny * t;
    const double reach = (30.9 - h * 0.25) / d[2];
    const Vec3 normal = normalized({nx, ny, 0.6});
    const Vec3 view = normalized({-x * s.scaleX, -y * s.scaleY, 1.0});
    const Vec3 half = normalized({view[0] + 5 * s.scaleX, view[1] - 5 * s.scaleY, view[2] + 1});
    return {
        {(d[0] * reach + x) / (s.width / 2) * 0.25 + 0.5, (d[1] * reach + y) / (s.height / 2) * -0.25 + 0.5,
         nx * 0.5 + 0.5 + y / s.width * 0.25, ny * 0.5 + 0.5 + x / s.height * 0.25, normal[0], normal[1], normal[2],
         half[0], half[1], half[2], h}};
}

// Linear interpolation over the triangle that holds (x, y): cells are split from top left to bottom right.
inline Varyings interpolate(const Scene& s, double x, double y) {
    const double across = (x + s.width / 2) / s.width * (s.n - 1);
    const double down = (s.height / 2 - y) / s.height * (s.n - 1);
    const int column = std::clamp(static_cast<int>(across), 0, s.n - 2);
    const int row = std::clamp(static_cast<int>(down), 0, s.n - 2);
    const double u = across - column;
    const double v = down - row;
    const Varyings topLeft = vertex(s, column, row);
    const Varyings bottomRight = vertex(s, column + 1, row + 1);
    const Varyings third = v > u ? vertex(s, column, row + 1) : vertex(s, column + 1, row);
    const double near = std::min(u, v);
    const double far = std::max(u, v);
    Varyings mixed;
    for (int i = 0; i < 11; ++i) {
        mixed.values[i] = (1 - far) * topLeft.values[i] + (far - near) * third.values[i] + near * bottomRight.values[i];
    }
    return mixed;
}

inline Vec3 sample(const Picture& picture, double u, double v) {
    const auto texel = [&picture](int i, int j, int channel) {
        i = std::clamp(i, 0, picture.width - 1);
        j = std::clamp(j, 0, picture.height - 1);
        return picture.rgba[static_cast<std::size_t>((j * picture.width + i) * 4 + channel)] / 255.0;
    };
    const double x = u * picture.width - 0.5;
    const double y = v * picture.height - 0.5;
    const int i = static_cast<int>(std::floor(x));
    const int j = static_cast<int>(std::floor(y));
    const double a = x - i;
    const double b = y - j;
    Vec3 color;
    for (int c = 0; c < 3; ++c) {
        color[static_cast<std::size_t>(c)] = (1 - b) * ((1 - a) * texel(i, j, c) + a * texel(i + 1, j, c)) +
                                             b * ((1 - a) * texel(i, j + 1, c) + a * texel(i + 1, j + 1, c));
    }
    return color;
}

// The colour, 0 to 1 and more, at model position (x, y), before any ink.
inline Vec3 waterColor(const Scene& s, double x, double y) {
    const Varyings v = interpolate(s, x, y);
    const Vec3 background = sample(*s.background, v.values[0], v.values[1]);
    const Vec3 water = sample(*s.water, v.values[2], v.values[3]);
    const Vec3 normal = {v.values[4], v.values[5], v.values[6]};
    const Vec3 half = {v.values[7], v.values[8], v.values[9]};
    const double shine = std::pow(std::max(dot(normal, half), 0.0), s.exponent);
    const double specular = std::clamp(s.specularRatio * shine, 1.0, s.specularLimit);
    const double facing = std::max(dot(normal, {5, -5, 1}), 0.0);
    const double t = std::clamp(std::fabs(v.values[10]), 0.0, 1.13);
    const double weight = t * specular * (s.alphaRatio1 + s.fresnelRatio * std::clamp(facing - 0.99, 0.0, 0.3));
    return {weight * water[0] + background[0], weight * water[1] + background[1], weight * water[2] + background[2]};
}

}  // namespace reference
