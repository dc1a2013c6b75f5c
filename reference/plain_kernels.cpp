// The formulas as plain loops over one value at a time. CMakeLists.txt compiles this file once per definition of
// PLAIN_KERNELS. The order of the arguments of min and max determines the result for NaN: a height stays NaN, a
// coordinate becomes 0, a speed counts as calm, a velocity is packed as 127.
#include <algorithm>
#include <cmath>
#include <vector>

#include "reference/kernel_set.h"

namespace {

bool wave(float* v, float* h, const WaveRegion& region, bool checkCalm, float damping, float waveSpeed) {
    const auto [xStart, yStart, xEnd, yEnd, stride] = region;
    static std::vector<float> copy;
    copy.resize(static_cast<std::size_t>(yEnd * stride + xEnd));
    float* const s = copy.data();

    bool calm = true;
    for (int y = yStart; y < yEnd; ++y) {
        for (int i = y * stride + xStart; i < y * stride + xEnd; ++i) {
            const float laplacian = -h[i] * 4.0f + h[i - stride] + h[i - 1] + h[i + 1] + h[i + stride];
            v[i] = (laplacian * waveSpeed + v[i]) * damping;
        }
        for (int i = y * stride + xStart; checkCalm && calm && i < y * stride + xEnd; ++i) {
            calm = !(v[i] > 0.009f || v[i] < -0.009f);
        }
    }
    for (int y = yStart; y < yEnd; ++y) {
        for (int i = y * stride + xStart; i < y * stride + xEnd; ++i) {
            h[i] = std::max(std::min(h[i] + v[i], 100.0f), -100.0f);
        }
    }
    const int first = (yStart - 1) * stride + xStart;
    std::copy(h + first, h + yEnd * stride + xEnd, s + first);
    const float k = damping == 0.94f ? 0.068f : 0.018f;
    for (int y = yStart; y < yEnd; ++y) {
        for (int i = y * stride + xStart; i < y * stride + xEnd; ++i) {
            const float laplacian = -s[i] * 4.0f + s[i - stride] + s[i - 1] + s[i + 1] + s[i + stride];
            h[i] = laplacian * k + h[i];
        }
    }
    return calm;
}

void ripple(const RippleField& field, float posA, float posB, float amplitude) {
    const float ca = (posA / static_cast<float>(field.extentA) + 0.5f) * static_cast<float>(field.countA);
    const float cb = (posB / static_cast<float>(field.extentB) + 0.5f) * static_cast<float>(field.countB);
    const auto first = [](float c) { return c > 5.0f ? static_cast<int>(std::floor(c - 3.0f)) : 2; };
    const auto end = [](float c, int count) {
        return static_cast<float>(count - 5) > c ? static_cast<int>(std::floor(c + 4.0f)) : count - 1;
    };
    for (int b = first(cb); b < end(cb, field.countB); ++b) {
        float* const row = field.values + b * field.countA;
        const float db = cb - static_cast<float>(b);
        for (int a = first(ca); a < end(ca, field.countA); ++a) {
            const float da = ca - static_cast<float>(a);
            const float height = 3.0f - std::sqrt(da * da + db * db);
            if (height > 0.0f) row[a] += height * amplitude;
        }
    }
}

vec2 sample(const vec2* texels, int width, int height, float u, float v) {
    const float x = static_cast<float>(width - 1) * std::min(std::max(0.0f, u), 1.0f);
    const float y = static_cast<float>(height - 1) * std::min(std::max(0.0f, v), 1.0f);
    const int x0 = static_cast<int>(x);
    const int y0 = static_cast<int>(y);
    const int x1 = std::min(x0 + 1, width - 1);
    const int y1 = std::min(y0 + 1, height - 1);
    const float tx = x - static_cast<float>(x0);
    const float ty = y - static_cast<float>(y0);
    return (1.0f - tx) * (1.0f - ty) * texels[y0 * width + x0] + tx * (1.0f - ty) * texels[y0 * width + x1] +
           (1.0f - tx) * ty * texels[y1 * width + x0] + tx * ty * texels[y1 * width + x1];
}

void advection(AdvectVelocityTShaderImpl& kernel) {
    const auto [in, width, height] = kernel.VelocityTexture;
    const vec2* const source = kernel.SourceTexture.data;
    vec2* const out = kernel.output.data;
    const vec2 inverseSize = kernel.InverseSize;
    const vec2 scale = kernel.Scale;
    const vec2 center = kernel.center;
    const vec2 push = (static_cast<float>(kernel.drag) - 1.5f) * kernel.delta;
    const float timeStep = kernel.TimeStep;
    const float dissipation = kernel.Dissipation;
    const bool dragged = kernel.drag > 0;
    for (int j = 0, at = 0; j < height; ++j) {
        for (int i = 0; i < width; ++i, ++at) {
            const auto x = static_cast<float>(i);
            const auto y = static_cast<float>(j);
            vec2 s = sample(
                source, width, height, ((x - timeStep * in[at].x) + 0.5f) * inverseSize.x,
                ((y - timeStep * in[at].y) + 0.5f) * inverseSize.y);
            if (dragged) {
                const float dx = center.x - scale.x * x;
                const float dy = center.y - scale.y * y;
                if (dx * dx + dy * dy < 625.0f) s = s + push;
            }
            out[at] = s * dissipation;
        }
    }
}

void forcing(AddVelocityTShaderImpl& kernel) {
    const auto [in, width, height] = kernel.Velocity;
    vec2* const out = kernel.output.data;
    const vec2 scale = kernel.Scale;
    const vec2 current = kernel.current;
    const vec2 previous = kernel.previous;
    const vec2 normal = kernel.normal;
    const float length = kernel.len;
    const float radius = kernel.Radius;
    for (int j = 0, at = 0; j < height; ++j) {
        for (int i = 0; i < width; ++i, ++at) {
            vec2 u = in[at];
            vec2 p = {(static_cast<float>(i) + 0.5f) * scale.x, (static_cast<float>(j) + 0.5f) * scale.y};
            const float t = normal.x * (p.x - previous.x) + normal.y * (p.y - previous.y);
            if (t > 0.0f && t < length) {
                vec2 foot = previous + t * normal;
                const float d = distance(p, foot);
                if (d < radius) u = u + d * (0.1f * (p - foot) + 0.1f * (current - foot));
            }
            out[at] = u;
        }
    }
}

// Calls texel(i, j, left, right, below, above) with the indices of the neighbours, clamped only at the border.
template <class Texel>
void withNeighbours(int width, int height, Texel texel) {
    const auto clamped = [=](int i, int j) {
        const int row = j * width;
        texel(
            i, j, row + std::max(i - 1, 0), row + std::min(i + 1, width - 1), std::max(j - 1, 0) * width + i,
            std::min(j + 1, height - 1) * width + i);
    };
    for (int j = 0; j < height; ++j) {
        if (j == 0 || j == height - 1) {
            for (int i = 0; i < width; ++i) clamped(i, j);
            continue;
        }
        clamped(0, j);
        for (int i = 1; i < width - 1; ++i) {
            const int at = j * width + i;
            texel(i, j, at - 1, at + 1, at - width, at + width);
        }
        clamped(width - 1, j);
    }
}

void divergence(ComputeDivergenceTShaderImpl& kernel) {
    const auto [in, width, height] = kernel.Velocity;
    float* const out = kernel.output.data;
    const vec2 scale = kernel.Scale;
    const vec2 center = kernel.center;
    const float halfInvCellSize = kernel.HalfInvCellSize;
    const float strength = kernel.SourceStrength;
    const float radiusSquared = kernel.SourceRadius * kernel.SourceRadius;
    withNeighbours(width, height, [=, in = in, width = width](int i, int j, int left, int right, int below, int above) {
        float value = (((in[right].x - in[left].x) + in[above].y) - in[below].y) * halfInvCellSize;
        const float dx = center.x - scale.x * static_cast<float>(i);
        const float dy = center.y - scale.y * static_cast<float>(j);
        if (dx * dx + dy * dy < radiusSquared) value -= strength;
        out[j * width + i] = value;
    });
}

void jacobi(JacobiTShaderImpl& kernel) {
    const auto [p, width, height] = kernel.Pressure;
    const float* const d = kernel.Divergence.data;
    float* const out = kernel.output.data;
    const float alpha = kernel.Alpha;
    const float inverseBeta = kernel.InverseBeta;
    std::fill_n(out, width * height, 0.0f);
    for (int j = 1; j < height - 1; ++j) {
        for (int i = j * width + 1; i < j * width + width - 1; ++i) {
            out[i] = ((((p[i - 1] + p[i + 1]) + p[i - width]) + p[i + width]) + alpha * d[i]) * inverseBeta;
        }
    }
}

void gradient(SubtractGradientTShaderImpl& kernel) {
    const auto [in, width, height] = kernel.Velocity;
    const float* const p = kernel.Pressure.data;
    vec2* const out = kernel.output.data;
    const float scale = kernel.GradientScale;
    withNeighbours(width, height, [=, in = in, width = width](int i, int j, int left, int right, int below, int above) {
        const int at = j * width + i;
        out[at] = {in[at].x - (p[right] - p[left]) * scale, in[at].y - (p[above] - p[below]) * scale};
    });
}

void packComponent(float c, unsigned char* bytes) {
    const float raised = (c < -127.0f ? -127.0f : std::min(127.0f, c)) + 127.0f;
    const float low = fract(raised);
    const float high = static_cast<float>(fract(raised * 0.0039215698f) - low / 255.0);
    bytes[0] = static_cast<unsigned char>(high * 255.0);
    bytes[1] = static_cast<unsigned char>(low * 255.0);
}

void packing(const vec2* velocity, std::size_t count, unsigned char* rgba) {
    for (std::size_t i = 0; i < count; ++i) {
        packComponent(velocity[i].x, rgba + 4 * i);
        packComponent(velocity[i].y, rgba + 4 * i + 2);
    }
}

}  // namespace

const KernelSet PLAIN_KERNELS = {
    .name = PLAIN_NAME,
    .wave = wave,
    .jacobi = jacobi,
    .ripple = ripple,
    .advection = advection,
    .forcing = forcing,
    .divergence = divergence,
    .gradient = gradient,
    .packing = packing,
};
