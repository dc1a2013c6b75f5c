// Each formula by itself and the CPU's part of an ink frame, in every form.
#include "bench/kernels.h"

#include <benchmark/benchmark.h>

#include <string>

#include "reference/ink_grid.h"
#include "reference/surface.h"

namespace {

constexpr const Forms* kForms[] = {&kLibrary, &kScalar, &kAutoVectorized, &kEigen};

// Waves fade; they start again before they change what a step costs.
constexpr int kStepsPerSurface = 64;

void steps(benchmark::State& state, const Forms& forms, Surface start, bool checkCalm) {
    Surface surface = start;
    int left = kStepsPerSurface;
    for (auto _ : state) {
        benchmark::DoNotOptimize(surface.step(forms, checkCalm));
        if (--left > 0) continue;
        surface = start;
        left = kStepsPerSurface;
    }
    state.counters["items"] = static_cast<double>(start.size());
}

// After `age` steps since a single drop on still water.
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
    for (const Forms* forms : kForms) {
        const std::string form = std::string("/") + forms->name;
        add("wave step" + size + form, [=](benchmark::State& state) { steps(state, *forms, Surface(n), false); });
        if (!forms->ripple) continue;
        add("ripple" + size + form, [=](benchmark::State& state) {
            Surface surface(n);
            for (auto _ : state) surface.ripple(*forms);
        });
    }
    // Every speed lies within the band, so every test runs.
    for (const bool checkCalm : {false, true}) {
        add("calm surface" + size + (checkCalm ? "/tested" : "/untested"),
            [=](benchmark::State& state) { steps(state, kLibrary, Surface(n, 0.0005f), checkCalm); });
    }
}

void addGrid(int viewWidth, int viewHeight) {
    const std::string size = "/" + std::to_string(viewWidth / 12) + "x" + std::to_string(viewHeight / 12);
    const auto addPass = [&](const char* what, const Forms& forms, void (*pass)(const Forms&, InkGrid&)) {
        add(what + size + "/" + forms.name, [=, &forms](benchmark::State& state) {
            InkGrid grid(viewWidth, viewHeight);
            grid.wholeFrame(kLibrary);
            for (auto _ : state) {
                pass(forms, grid);
                benchmark::ClobberMemory();
            }
            state.counters["items"] = grid.width * grid.height;
        });
    };
    for (const Forms* forms : kForms) {
        addPass("pressure solve", *forms, [](const Forms& f, InkGrid& grid) { grid.solvePressure(f); });
        if (!forms->advection) continue;
        addPass("velocity advection", *forms, [](const Forms& f, InkGrid& grid) { f.advection(grid.advect); });
        addPass("divergence", *forms, [](const Forms& f, InkGrid& grid) { f.divergence(grid.diverge); });
        addPass("gradient", *forms, [](const Forms& f, InkGrid& grid) { f.gradient(grid.subtract); });
        addPass("forcing", *forms, [](const Forms& f, InkGrid& grid) { f.forcing(grid.push); });
        addPass("packing", *forms, [](const Forms& f, InkGrid& grid) { grid.pack(f); });
        addPass("ink frame", *forms, [](const Forms& f, InkGrid& grid) { grid.wholeFrame(f); });
    }
}

}  // namespace

void registerKernels() {
    for (const int n : {64, 96, 128, 192, 256}) addSurface(n);
    addGrid(540, 960);
    addGrid(1080, 1920);
    addGrid(2160, 3840);
    for (const int age : {100, 2000, 10000, 30000}) {
        add("aged surface/128/" + std::to_string(age),
            [=](benchmark::State& state) { steps(state, kLibrary, agedSurface(128, age), true); });
    }
}
