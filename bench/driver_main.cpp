// Measures whole frames on the machine's OpenGL ES driver, each until glFinish returns.
#include <GLES2/gl2.h>
#include <benchmark/benchmark.h>

#include <cstdio>
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

}  // namespace

int main(int argc, char** argv) {
    for (const Scene scene : {Scene::water, Scene::idleInk, Scene::drag}) {
        benchmark::RegisterBenchmark((std::string("driver/") + nameOf(scene)).c_str(), frames, scene, 1080, 1920)
            ->Unit(benchmark::kMicrosecond)
            ->UseRealTime();
    }
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
