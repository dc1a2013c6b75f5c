#include "tshader/AddVelocityTShaderImpl.h"

#include <algorithm>

#include "base/groups.h"
#include "tshader/pairs.h"

namespace {

struct Segment {
    vec2 current, previous, normal;
    float len, radius;
};

struct Range {
    int first, end;
};

// Returns the new velocity at p. It changes if the projection of p onto the segment is strictly between the ends.
// By contract the push grows with the distance d: u + d * (0.1 * (p - foot) + 0.1 * (current - foot)).
template <class F>
Pair<F> push(Pair<F> velocity, F px, F py, const Segment& segment) {
    const F t = segment.normal.x * (px - segment.previous.x) + segment.normal.y * (py - segment.previous.y);
    const F footX = segment.previous.x + t * segment.normal.x;
    const F footY = segment.previous.y + t * segment.normal.y;
    const F dx = px - footX;
    const F dy = py - footY;
    const F d = squareRoot(dx * dx + dy * dy);
    const auto reached = (t > 0.0f) & (t < segment.len) & (d < segment.radius);
    return {
        reached ? velocity.x + d * (0.1f * dx + 0.1f * (segment.current.x - footX)) : velocity.x,
        reached ? velocity.y + d * (0.1f * dy + 0.1f * (segment.current.y - footY)) : velocity.y};
}

// Returns the texels of one axis within `radius` of the interval between `from` and `to`, widened by one texel on each
// side against rounding. A NaN fails the comparisons and gives the whole axis.
Range reach(float from, float to, float radius, float scale, int size) {
    const float first = (std::min(from, to) - radius) / scale - 1.5f;
    const float last = (std::max(from, to) + radius) / scale + 1.5f;
    const float limit = static_cast<float>(size);
    return {
        first > 0.0f ? (first < limit ? static_cast<int>(first) : size) : 0,
        last < limit ? (last > 0.0f ? static_cast<int>(last) + 1 : 0) : size};
}

}  // namespace

void AddVelocityTShaderImpl::shaderMain(const vec4& fragCoord, vec2& out) {
    const vec2 fragment = Vec2(fragCoord.x, fragCoord.y);
    const vec2 u = texture2D(Velocity, fragment * InverseSize);
    const vec2 p = Scale * fragment;
    storePairs(push({u.x, u.y}, p.x, p.y, {current, previous, normal, len, Radius}), &out);
}

void AddVelocityTShaderImpl::run() {
    if (output.empty()) return;
    const int width = output.width;
    const int height = output.height;
    const vec2 scale = Scale;
    const Segment segment = {current, previous, normal, len, Radius};
    const vec2 end = segment.previous + segment.len * segment.normal;
    const Range columns = reach(segment.previous.x, end.x, segment.radius, scale.x, width);
    const Range rows = reach(segment.previous.y, end.y, segment.radius, scale.y, height);

    for (int j = 0; j < height; ++j) {
        const vec2* in = Velocity.row(j);
        vec2* out = output.row(j);
        if (j < rows.first || j >= rows.end) {
            std::copy_n(in, width, out);
            continue;
        }

        const float py = (static_cast<float>(j) + 0.5f) * scale.y;
        std::copy_n(in, columns.first, out);
        forGroups(columns.first, columns.end, [=]<class F>(F, int i) {
            const F px = (countUp<F>(i) + 0.5f) * scale.x;
            storePairs(push(loadPairs<F>(in + i), px, F{} + py, segment), out + i);
        });
        std::copy(in + columns.end, in + width, out + columns.end);
    }
}
