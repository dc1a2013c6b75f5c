#include <benchmark/benchmark.h>

#include "bench/forms_agree.h"
#include "bench/frames.h"
#include "bench/kernels.h"

int main(int argc, char** argv) {
    if (!formsAgree()) return 1;
    registerKernels();
    registerFrames();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
