// Measures whole frames on the machine's OpenGL ES driver, each until glFinish returns, and the start up to the first
// one.
#include <GLES2/gl2.h>
#include <android/log.h>
#include <benchmark/benchmark.h>

#include <chrono>
#include <map>
#include <string>

#include "bench/frame_scene.h"
#include "desktop/headless_context.h"

using namespace tidemark;

namespace {

void frames(benchmark::State& run, Scene kind, int width, int height) {
    std::string error;
    const auto context = HeadlessContext::create(width, height, error);
    if (!context) {
        run.SkipWithError(error.c_str());
        return;
    }
    run.SetLabel(reinterpret_cast<const char*>(glGetString(GL_RENDERER)));
    FrameScene scene(kind, 128, width, height, 10);
    glFinish();  // Completes the work of the set-up before the measurement.
    for (auto _ : run) {
        scene.next();
        glFinish();
    }
}

// Measures the time from a new context to the first frame. The pictures are decoded: that is done before, elsewhere.
void start(benchmark::State& run, bool withInk, int width, int height) {
    __android_log_set_logger([](const __android_log_message*) {});
    const Pictures pictures = {
        smoothPicture(width, height, 1), smoothPicture(height, width, 2), smoothPicture(512, 512, 3)};
    std::map<std::string, double> parts;
    for (auto _ : run) {
        auto before = std::chrono::steady_clock::now();
        const auto endPart = [&](const char* part) {
            const auto now = std::chrono::steady_clock::now();
            parts[part] += std::chrono::duration<double, std::milli>(now - before).count();
            before = now;
        };
        std::string error;
        const auto context = HeadlessContext::create(width, height, error);
        if (!context) return run.SkipWithError(error.c_str());
        endPart("context");
        WaterHost host(Look{}, width, height, 1);
        host.setUp(withInk);
        glFinish();
        endPart("programs");
        host.loadPictures(sourceOf(pictures));
        glFinish();
        endPart("pictures");
        host.advance(1.0 / 60.0);
        host.draw();
        glFinish();
        endPart("frame");
    }
    for (const auto& [part, milliseconds] : parts) {
        run.counters[part] = benchmark::Counter(milliseconds, benchmark::Counter::kAvgIterations);
    }
}

}  // namespace

int main(int argc, char** argv) {
    for (const Scene scene : {Scene::water, Scene::idleInk, Scene::drag}) {
        benchmark::RegisterBenchmark((std::string("driver/") + nameOf(scene)).c_str(), frames, scene, 1080, 1920)
            ->Unit(benchmark::kMicrosecond)
            ->UseRealTime();
    }
    for (const bool withInk : {false, true}) {
        benchmark::RegisterBenchmark(withInk ? "start/ink" : "start/water", start, withInk, 1080, 1920)
            ->Unit(benchmark::kMicrosecond)
            ->UseRealTime();
    }
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
