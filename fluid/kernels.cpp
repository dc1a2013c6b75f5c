#include "fluid/fluid.h"
#include "fluid/touch.h"

// Each method sets the textures and uniforms of its kernel and runs it.

namespace {

// Size of a grid cell in screen pixels.
vec2 cellSize(const Fluid& f) {
    return Vec2(
        static_cast<float>(f.ScreenWidth) / static_cast<float>(f.GridWidth),
        static_cast<float>(f.ScreenHeight) / static_cast<float>(f.GridHeight));
}

// Size of a grid cell in texture coordinates.
vec2 inverseSize(const Fluid& f) {
    return Vec2(1.0f / static_cast<float>(f.GridWidth), 1.0f / static_cast<float>(f.GridHeight));
}

}  // namespace

void Fluid::AdvectVelocity(Texture<vec2> velocity, Texture<vec2> source, Texture<vec2> dest, float dissipation) {
    const Touch touch = latestTouch(*this);
    AdvectVelocityTShaderImpl& kernel = AdvectVelocityKernel;
    kernel.VelocityTexture = velocity;
    kernel.SourceTexture = source;
    kernel.output = dest;
    kernel.InverseSize = inverseSize(*this);
    kernel.Scale = cellSize(*this);
    kernel.TimeStep = TimeStep;
    kernel.Dissipation = dissipation;
    kernel.center = Vec2(static_cast<float>(touch.x), static_cast<float>(touch.y));
    kernel.delta = Vec2(static_cast<float>(touch.dx), static_cast<float>(touch.dy));
    kernel.drag = DragMode;
    kernel.run();
}

void Fluid::AddVelocity(Texture<vec2> velocity, Texture<vec2> dest, Vector_ previous, Vector_ current) {
    const Segment segment = segmentBetween(previous, current);
    AddVelocityTShaderImpl& kernel = AddVelocityKernel;
    kernel.Velocity = velocity;
    kernel.output = dest;
    kernel.Scale = cellSize(*this);
    kernel.InverseSize = inverseSize(*this);
    kernel.current = Vec2(current.x, current.y);
    kernel.previous = Vec2(previous.x, previous.y);
    kernel.normal = Vec2(segment.normal.x, segment.normal.y);
    kernel.len = segment.length;
    kernel.Radius = Radius;
    kernel.run();
}

void Fluid::ComputeDivergence(Texture<vec2> velocity, Texture<float> dest, Vector_ point) {
    ComputeDivergenceTShaderImpl& kernel = ComputeDivergenceKernel;
    kernel.Velocity = velocity;
    kernel.output = dest;
    kernel.Scale = cellSize(*this);
    kernel.InverseSize = inverseSize(*this);
    kernel.HalfInvCellSize = 0.5f / CellSize;
    kernel.SourceStrength = SourceStrength;
    kernel.SourceRadius = SourceRadius;
    kernel.center = Vec2(point.x, point.y);
    kernel.run();
}

void Fluid::Jacobi(Texture<float> pressure, Texture<float> divergence, Texture<float> dest) {
    JacobiTShaderImpl& kernel = JacobiKernel;
    kernel.Pressure = pressure;
    kernel.Divergence = divergence;
    kernel.output = dest;
    kernel.Alpha = -CellSize * CellSize;
    kernel.InverseBeta = 0.25f;
    kernel.InverseSize = Vec2(static_cast<float>(1.0 / GridWidth), static_cast<float>(1.0 / GridHeight));
    kernel.run();
}

void Fluid::SubtractGradient(Texture<vec2> velocity, Texture<float> pressure, Texture<vec2> dest) {
    SubtractGradientTShaderImpl& kernel = SubtractGradientKernel;
    kernel.Velocity = velocity;
    kernel.Pressure = pressure;
    kernel.output = dest;
    kernel.InverseSize = inverseSize(*this);
    kernel.GradientScale = GradientScale;
    kernel.run();
}
