#include <benchmark/benchmark.h>

#include "bench/frames.h"
#include "bench/kernel_sets_agree.h"
#include "bench/kernels.h"

int main(int argc, char** argv) {
    if (!kernelSetsAgree()) return 1;
    registerKernels();
    registerFrames();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
