// Measures each formula, and all kernels of an ink frame together, with every kernel set. The ink's field is noise,
// whose back-traces end far apart, or that of a fast drag.
#include "bench/kernels.h"

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "bench/frame_scene.h"
#include "jni/globals.h"
#include "reference/ink_grid.h"
#include "reference/surface.h"

using namespace tidemark;

namespace {

constexpr const KernelSet* kKernelSets[] = {&kLibrary, &kScalar, &kAutoVectorized, &kEigen};

// The surface is reset after so many steps, before the decay of the waves affects the time of a step.
constexpr int kStepsPerSurface = 64;

void steps(benchmark::State& run, const KernelSet& kernels, Surface start, bool checkCalm) {
    Surface surface = start;
    int left = kStepsPerSurface;
    for (auto _ : run) {
        benchmark::DoNotOptimize(surface.step(kernels, checkCalm));
        if (--left > 0) continue;
        surface = start;
        left = kStepsPerSurface;
    }
    run.counters["items"] = static_cast<double>(start.size());
}

// Returns a calm surface `age` steps after a single drop.
Surface agedSurface(int vertices, int age) {
    Surface surface(vertices, 0.0f);
    surface.ripple(kLibrary);
    for (int i = 0; i < age; ++i) surface.step(kLibrary, true);
    return surface;
}

template <class Body>
void add(const std::string& name, Body body) {
    benchmark::RegisterBenchmark(name.c_str(), body)->Unit(benchmark::kMicrosecond);
}

void addSurface(int n) {
    const std::string size = "/" + std::to_string(n);
    for (const KernelSet* kernels : kKernelSets) {
        const std::string form = std::string("/") + kernels->name;
        add("wave step" + size + form, [=](benchmark::State& run) { steps(run, *kernels, Surface(n), false); });
        if (!kernels->ripple) continue;
        add("ripple" + size + form, [=](benchmark::State& run) {
            Surface surface(n);
            for (auto _ : run) surface.ripple(*kernels);
        });
    }
    // On a calm surface the calm test never stops early.
    for (const bool checkCalm : {false, true}) {
        add("calm surface" + size + (checkCalm ? "/tested" : "/untested"),
            [=](benchmark::State& run) { steps(run, kLibrary, Surface(n, 0.0005f), checkCalm); });
    }
}

void addGrid(int viewWidth, int viewHeight) {
    const std::string size = "/" + std::to_string(viewWidth / 12) + "x" + std::to_string(viewHeight / 12);
    const auto addPass = [&](const char* what, const KernelSet& kernels, void (*pass)(const KernelSet&, InkGrid&)) {
        add(what + size + "/" + kernels.name, [=, &kernels](benchmark::State& run) {
            InkGrid grid(viewWidth, viewHeight);
            grid.wholeFrame(kLibrary);
            for (auto _ : run) {
                pass(kernels, grid);
                benchmark::ClobberMemory();
            }
            run.counters["items"] = grid.width * grid.height;
        });
    };
    for (const KernelSet* kernels : kKernelSets) {
        addPass("pressure solve", *kernels, [](const KernelSet& f, InkGrid& grid) { grid.solvePressure(f); });
        if (!kernels->advection) continue;
        addPass("velocity advection", *kernels, [](const KernelSet& f, InkGrid& grid) { f.advection(grid.advect); });
        addPass("divergence", *kernels, [](const KernelSet& f, InkGrid& grid) { f.divergence(grid.diverge); });
        addPass("gradient", *kernels, [](const KernelSet& f, InkGrid& grid) { f.gradient(grid.subtract); });
        addPass("forcing", *kernels, [](const KernelSet& f, InkGrid& grid) { f.forcing(grid.push); });
        addPass("packing", *kernels, [](const KernelSet& f, InkGrid& grid) { grid.pack(f); });
        addPass("ink frame", *kernels, [](const KernelSet& f, InkGrid& grid) { grid.wholeFrame(f); });
    }
}

// The velocities of a fast drag after a second.
std::vector<vec2> dragField(int viewWidth, int viewHeight) {
    const FrameScene scene(Scene::drag, 128, viewWidth, viewHeight, 60);
    const Texture<vec2>& field = fluid.VelocityTex;
    return {field.data, field.data + field.width * field.height};
}

void addDragGrid(int viewWidth, int viewHeight) {
    const std::string size = "/" + std::to_string(viewWidth / 12) + "x" + std::to_string(viewHeight / 12);
    const auto addPass = [&](const char* what, const KernelSet& kernels, void (*pass)(const KernelSet&, InkGrid&)) {
        add(what + size + "/" + kernels.name, [=, &kernels](benchmark::State& run) {
            InkGrid grid(viewWidth, viewHeight);
            grid.velocity = dragField(viewWidth, viewHeight);
            grid.advect.VelocityTexture.data = grid.advect.SourceTexture.data = grid.velocity.data();
            for (auto _ : run) {
                pass(kernels, grid);
                benchmark::ClobberMemory();
            }
        });
    };
    for (const KernelSet* kernels : {&kLibrary, &kScalar, &kAutoVectorized}) {
        addPass("drag advection", *kernels, [](const KernelSet& f, InkGrid& grid) { f.advection(grid.advect); });
        addPass("drag frame", *kernels, [](const KernelSet& f, InkGrid& grid) { grid.wholeFrame(f); });
    }
}

}  // namespace

void registerKernels() {
    for (const int n : {64, 96, 128, 192, 256}) addSurface(n);
    addGrid(540, 960);
    addGrid(1080, 1920);
    addGrid(2160, 3840);
    addDragGrid(1080, 1920);
    addDragGrid(2160, 3840);
    for (const int age : {100, 2000, 10000, 30000}) {
        add("aged surface/128/" + std::to_string(age),
            [=](benchmark::State& run) { steps(run, kLibrary, agedSurface(128, age), true); });
    }
}
