// Measures the CPU time of whole frames with a GL that only counts its calls.
#include "bench/frames.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdint>
#include <string>
#include <vector>

#include "bench/frame_scene.h"
#include "fluid/fluid.h"
#include "host/breeze.h"
#include "host/surface_mesh.h"
#include "jni/globals.h"
#include "jni/ink_frame.h"
#include "probes/counting_gl.h"
#include "probes/gesture_state.h"
#include "probes/library_blocks.h"

using namespace tidemark;

namespace {

void frames(benchmark::State& run, Scene kind, int vertices, int width, int height) {
    FrameScene scene(kind, vertices, width, height, 120);
    for (auto _ : run) scene.next();

    constexpr int kCounted = 60;
    takeGlUse();
    const int before = LibraryBlocks::requested;
    for (int i = 0; i < kCounted; ++i) scene.next();
    const int allocations = LibraryBlocks::requested - before;
    const GlUse use = takeGlUse();
    double calls = 0;
    for (const auto& [name, count] : use.calls) calls += count;
    run.counters["calls"] = calls / kCounted;
    run.counters["bytes"] = static_cast<double>(use.bytes) / kCounted;
    run.counters["allocations"] = static_cast<double>(allocations) / kCounted;
}

// Measures the interpolation of mesh heights, with and without a breeze, from the waves of rain in a 9:16 view.
void meshHeights(benchmark::State& run, int vertices, bool isBreezy) {
    const FrameScene scene(Scene::water, 128, 1080, 1920, 120);
    const WaveLattice& lattice = scene.host().lattice();
    const std::vector<float>& waves = scene.host().heights();
    Breeze breeze(lattice);
    SurfaceMesh mesh(lattice.points, vertices, 9.0 / 16, 1.0);
    const auto seen = static_cast<std::size_t>(mesh.columns().count * mesh.rows().count);
    std::vector<float> attribs(3 * seen);
    std::vector<std::int16_t> indices(6 * seen);
    mesh.layCells(indices.data());
    double time = 0.0;
    for (auto _ : run) {
        breeze.blow(0.02f, time += 1.0 / 60.0);
        mesh.gather(waves.data(), waves.data(), 0.0f, attribs.data(), indices.data(), isBreezy ? &breeze : nullptr);
        benchmark::ClobberMemory();
    }
}

// Measures the ink's part of a frame, `age` frames after the end of a fast drag.
void agedInk(benchmark::State& run, int age) {
    __android_log_set_logger([](const __android_log_message*) {});
    resetGestures();
    fluid.InitializeSetting(1080, 1920, true);
    fluid.InitializeGPU(true);
    POSITION_Y = 960;
    isMovingEvent = 2;
    for (int i = 0; i < 20; ++i) {
        state = 2;
        POSITION_X = 300 + 20 * i;
        DX = 20;
        stepInk({0.1f, 0.1f, 0.1f});
    }
    state = 0;
    DX = 0;
    fluid.SourceStrength = 0.0f;
    fluid.VelocityDissipation = 0.9f;
    for (int i = 0; i < age; ++i) stepInk({0.1f, 0.1f, 0.1f});

    const auto& field = fluid.VelocityTex;
    const std::vector<vec2> start(field.data, field.data + field.width * field.height);
    constexpr int kFramesPerField = 16;
    int left = kFramesPerField;
    for (auto _ : run) {
        fluid.Update(0);
        if (--left > 0) continue;
        std::ranges::copy(start, field.data);
        left = kFramesPerField;
    }
}

void addFrames(Scene scene, int vertices, int width, int height) {
    const std::string name = std::string("frame/") + nameOf(scene) + "/" + std::to_string(vertices) + "/" +
                             std::to_string(width) + "x" + std::to_string(height);
    benchmark::RegisterBenchmark(name.c_str(), frames, scene, vertices, width, height)->Unit(benchmark::kMicrosecond);
}

}  // namespace

void registerFrames() {
    for (const Scene scene : {Scene::water, Scene::idleInk, Scene::drag}) addFrames(scene, 128, 1080, 1920);
    for (const int n : {64, 96, 192, 256}) addFrames(Scene::water, n, 1080, 1920);
    for (const int n : {64, 96, 128, 192, 256}) {
        for (const bool isBreezy : {false, true}) {
            const std::string name = (isBreezy ? "breezy heights/" : "mesh heights/") + std::to_string(n);
            benchmark::RegisterBenchmark(name.c_str(), meshHeights, n, isBreezy)->Unit(benchmark::kMicrosecond);
        }
    }
    addFrames(Scene::drag, 128, 540, 960);
    addFrames(Scene::drag, 128, 2160, 3840);
    for (const int age : {10, 500, 1000, 2000, 3000}) {
        benchmark::RegisterBenchmark(("aged ink/90x160/" + std::to_string(age)).c_str(), agedInk, age)
            ->Unit(benchmark::kMicrosecond);
    }
}
