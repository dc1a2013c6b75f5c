// Float vectors with the GLSL operators and functions that the kernels use.
#pragma once

#include <cmath>

struct vec2 {
    float x, y;
};

struct vec4 {
    float x, y, z, w;
};

inline vec2 Vec2(float s) {
    return vec2{s, s};
}

inline vec2 Vec2(float x, float y) {
    return vec2{x, y};
}

inline vec4 Vec4(float x, float y, float z, float w) {
    return vec4{x, y, z, w};
}

inline vec4 Vec4(vec2 a, vec2 b) {
    return vec4{a.x, a.y, b.x, b.y};
}

inline vec2 operator+(const vec2& a, const vec2& b) {
    return vec2{a.x + b.x, a.y + b.y};
}

inline vec2 operator-(const vec2& a, const vec2& b) {
    return vec2{a.x - b.x, a.y - b.y};
}

inline vec2 operator*(const vec2& a, const vec2& b) {
    return vec2{a.x * b.x, a.y * b.y};
}

inline vec2 operator*(const float& s, const vec2& v) {
    return vec2{s * v.x, s * v.y};
}

inline vec2 operator*(const vec2& v, const float& s) {
    return vec2{v.x * s, v.y * s};
}

inline vec2 operator/(float s, const vec2& v) {
    return vec2{s / v.x, s / v.y};
}

// Divides each component, because multiplying by 1 / s would round twice.
inline vec2 operator/(const vec2& v, const float& s) {
    return vec2{v.x / s, v.y / s};
}

inline vec4 operator+(const vec4& a, const vec4& b) {
    return vec4{a.x + b.x, a.y + b.y, a.z + b.z, a.w + b.w};
}

inline vec4 operator/(const vec4& v, const float& s) {
    return vec4{v.x / s, v.y / s, v.z / s, v.w / s};
}

inline vec4 operator*(const float& s, const vec4& v) {
    return vec4{s * v.x, s * v.y, s * v.z, s * v.w};
}

inline vec4 operator*(const vec4& v, const float& s) {
    return vec4{v.x * s, v.y * s, v.z * s, v.w * s};
}

// A comparison of a vector is true if it is true for every component.
inline bool isLE(const float& a, float b) {
    return a <= b;
}

inline bool isLE(const vec2& v, float b) {
    return v.x <= b && v.y <= b;
}

inline bool isLE(const vec4& v, float b) {
    return v.x <= b && v.y <= b && v.z <= b && v.w <= b;
}

inline bool isGT(const float& a, float b) {
    return a > b;
}

inline bool isGT(const vec2& v, float b) {
    return v.x > b && v.y > b;
}

inline bool isGT(const vec4& v, float b) {
    return v.x > b && v.y > b && v.z > b && v.w > b;
}

// Computed in double precision, so that only the conversion to float rounds.
inline float fract(float x) {
    const double exact = x;
    return static_cast<float>(exact - std::floor(exact));
}

inline vec2 fract(vec2& v) {
    return vec2{fract(v.x), fract(v.y)};
}

inline float dot(vec2& a, vec2& b) {
    return a.x * b.x + a.y * b.y;
}

inline float distanceNoSqrt(vec2& a, vec2& b) {
    const float dx = a.x - b.x;
    const float dy = a.y - b.y;
    return dx * dx + dy * dy;
}

inline float distance(vec2& a, vec2& b) {
    return std::sqrt(distanceNoSqrt(a, b));
}
