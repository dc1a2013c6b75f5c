#include "reference/ink_grid.h"

#include <algorithm>
#include <random>

InkGrid::InkGrid(int viewWidth, int viewHeight) : width(viewWidth / 12), height(viewHeight / 12) {
    const auto texels = static_cast<std::size_t>(width * height);
    std::mt19937 random(1);
    std::uniform_real_distribution<float> speed(-20.0f, 20.0f);
    velocity.resize(texels);
    for (vec2& v : velocity) v = {speed(random), speed(random)};
    advected.resize(texels);
    projected.resize(texels);
    pushed.resize(texels);
    divergence.resize(texels);
    pressure.resize(texels);
    pressureTemp.resize(texels);
    bytes.resize(4 * texels);

    const auto texture = [this]<class T>(std::vector<T>& values) { return Texture<T>{values.data(), width, height}; };
    const auto columns = static_cast<float>(width);
    const auto rows = static_cast<float>(height);
    const vec2 inverseSize = {1.0f / columns, 1.0f / rows};
    const vec2 scale = {12.0f, 12.0f};
    const vec2 touch = {6.0f * columns, 6.0f * rows};
    const vec2 movement = {24.0f, 18.0f};

    advect.output = texture(advected);
    advect.VelocityTexture = advect.SourceTexture = texture(velocity);
    advect.InverseSize = inverseSize;
    advect.Scale = scale;
    advect.TimeStep = 0.25f;
    advect.Dissipation = 0.96f;
    advect.center = touch;
    advect.delta = movement;
    advect.drag = 2;

    diverge.output = texture(divergence);
    diverge.Velocity = texture(advected);
    diverge.Scale = scale;
    diverge.InverseSize = inverseSize;
    diverge.HalfInvCellSize = 0.2f;
    diverge.SourceStrength = 20.0f;
    diverge.SourceRadius = 4.0f;
    diverge.center = touch;

    relax.Divergence = texture(divergence);
    relax.Alpha = -6.25f;
    relax.InverseBeta = 0.25f;
    relax.InverseSize = inverseSize;

    subtract.output = texture(projected);
    subtract.Velocity = texture(advected);
    subtract.Pressure = texture(pressure);
    subtract.InverseSize = inverseSize;
    subtract.GradientScale = 0.2f;

    push.output = texture(pushed);
    push.Velocity = texture(projected);
    push.Scale = scale;
    push.InverseSize = inverseSize;
    push.current = touch;
    push.previous = touch - movement;
    push.normal = movement / 30.0f;
    push.len = 30.0f;
    push.Radius = 30.0f;
}

void InkGrid::solvePressure(const KernelSet& kernels) {
    std::ranges::fill(pressure, 0.0f);
    relax.Pressure = {pressure.data(), width, height};
    relax.output = {pressureTemp.data(), width, height};
    for (int i = 0; i < 5; ++i) {
        kernels.jacobi(relax);
        std::swap(relax.Pressure, relax.output);
    }
    subtract.Pressure = relax.Pressure;
}

void InkGrid::wholeFrame(const KernelSet& kernels) {
    kernels.advection(advect);
    kernels.divergence(diverge);
    solvePressure(kernels);
    kernels.gradient(subtract);
    pack(kernels);
    kernels.forcing(push);
}
