// Prints a hash of what every hot loop makes of fixed inputs. Two processors agree bit for bit when the two outputs are
// equal, and a line that differs names the loop.
//
// Left out, as processors may differ there: the sign and payload of a NaN, and results around the smallest normal
// number, which one processor flushes to zero before it rounds and another after.
#include <bit>
#include <cstdint>
#include <cstdio>
#include <random>
#include <span>
#include <vector>

#include "tshader/AddVelocityTShaderImpl.h"
#include "tshader/AdvectVelocityTShaderImpl.h"
#include "tshader/ComputeDivergenceTShaderImpl.h"
#include "tshader/JacobiTShaderImpl.h"
#include "tshader/SubtractGradientTShaderImpl.h"
#include "tshader/velocity_packing.h"
#include "water/mesh.h"
#include "water/ripples.h"
#include "water/waves.h"

namespace {

// FNV-1a over the bytes.
template <class T>
void print(const char* what, const std::vector<T>& values) {
    std::uint64_t hash = 0xcbf29ce484222325u;
    for (const std::byte byte : std::as_bytes(std::span(values))) {
        hash = (hash ^ static_cast<std::uint64_t>(byte)) * 0x100000001b3u;
    }
    std::printf("%-20s %016llx\n", what, static_cast<unsigned long long>(hash));
}

// Every number is a fraction of 2^16: the library's own distributions may differ.
std::vector<float> noise(std::size_t count, float limit, unsigned seed) {
    std::mt19937 bits(seed);
    std::vector<float> values(count);
    for (float& value : values) value = (static_cast<float>(bits() >> 16) / 32768.0f - 1.0f) * limit;
    return values;
}

std::vector<vec2> noisePairs(std::size_t count, float limit, unsigned seed) {
    const std::vector<float> values = noise(2 * count, limit, seed);
    std::vector<vec2> pairs(count);
    for (std::size_t i = 0; i < count; ++i) pairs[i] = {values[2 * i], values[2 * i + 1]};
    return pairs;
}

void printWater(int n, float damping) {
    const auto size = static_cast<std::size_t>(n * n);
    std::vector<float> velocity = noise(size, 0.1f, 1);
    std::vector<float> height = noise(size, 1.0f, 2);
    std::vector<char> calm;
    for (int i = 0; i < 200; ++i) {
        if (i % 20 == 0) addRipple({height.data(), 32, 32, n, n}, 0.31f * static_cast<float>(i) - 16.0f, 3.7f, 0.9f);
        calm.push_back(stepWaves(velocity.data(), height.data(), {1, 1, n - 1, n - 1, n}, true, damping, 0.32f));
    }
    print("water velocity", velocity);
    print("water height", height);
    print("water calm", calm);
}

void printMesh(int n) {
    std::vector<float> positions(static_cast<std::size_t>(3 * n * n));
    std::vector<std::int16_t> indices(static_cast<std::size_t>(6 * (n - 1) * (n - 1)));
    fillPositions(positions.data(), n * n, 32, 32, n, n);
    fillIndices(indices.data(), n, n);
    print("mesh positions", positions);
    print("mesh indices", indices);
}

void printInk(int width, int height, int drag) {
    const auto texels = static_cast<std::size_t>(width * height);
    std::vector<vec2> velocity = noisePairs(texels, 40.0f, 3);
    std::vector<vec2> moved(texels);
    std::vector<float> divergence(texels);
    std::vector<float> pressure(texels);
    std::vector<float> relaxed(texels);
    std::vector<unsigned char> bytes(4 * texels);
    const auto texture = [=]<class T>(std::vector<T>& values) { return Texture<T>{values.data(), width, height}; };
    const vec2 inverseSize = {1.0f / static_cast<float>(width), 1.0f / static_cast<float>(height)};
    const vec2 scale = {12.1f, 12.3f};
    const vec2 touch = {211.0f, 187.0f};

    AdvectVelocityTShaderImpl advect;
    advect.output = texture(moved);
    advect.VelocityTexture = advect.SourceTexture = texture(velocity);
    advect.InverseSize = inverseSize;
    advect.Scale = scale;
    advect.TimeStep = 0.25f;
    advect.Dissipation = 0.94f;
    advect.center = touch;
    advect.delta = {21.0f, -13.0f};
    advect.drag = drag;
    advect.run();
    print("advection", moved);

    ComputeDivergenceTShaderImpl diverge;
    diverge.output = texture(divergence);
    diverge.Velocity = texture(moved);
    diverge.Scale = scale;
    diverge.HalfInvCellSize = 0.2f;
    diverge.SourceStrength = 20.0f;
    diverge.SourceRadius = 40.0f;
    diverge.center = touch;
    diverge.run();
    print("divergence", divergence);

    JacobiTShaderImpl relax;
    relax.Divergence = texture(divergence);
    relax.Alpha = -6.25f;
    relax.InverseBeta = 0.25f;
    for (int i = 0; i < 5; ++i) {
        relax.Pressure = texture(pressure);
        relax.output = texture(relaxed);
        relax.run();
        std::swap(pressure, relaxed);
    }
    print("pressure", pressure);

    SubtractGradientTShaderImpl subtract;
    subtract.output = texture(velocity);
    subtract.Velocity = texture(moved);
    subtract.Pressure = texture(pressure);
    subtract.GradientScale = 0.2f;
    subtract.run();
    print("gradient", velocity);

    AddVelocityTShaderImpl push;
    push.output = texture(moved);
    push.Velocity = texture(velocity);
    push.Scale = scale;
    push.current = touch;
    push.previous = touch - Vec2(90.0f, 120.0f);
    push.normal = {0.6f, 0.8f};
    push.len = 150.0f;
    push.Radius = 30.0f;
    push.run();
    print("forcing", moved);

    packVelocity(moved.data(), moved.size(), bytes.data());
    print("packing", bytes);
}

}  // namespace

int main() {
    printMesh(37);
    printWater(37, 0.985f);
    printWater(64, 0.94f);
    printInk(41, 33, 2);
    printInk(90, 160, 0);
}
