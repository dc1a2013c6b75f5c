#include "reference/kernel_set.h"
#include "tshader/velocity_packing.h"

const KernelSet kLibrary = {
    .name = "library",
    .wave = stepWaves,
    .jacobi = [](JacobiTShaderImpl& kernel) { kernel.run(); },
    .ripple = addRipple,
    .advection = [](AdvectVelocityTShaderImpl& kernel) { kernel.run(); },
    .forcing = [](AddVelocityTShaderImpl& kernel) { kernel.run(); },
    .divergence = [](ComputeDivergenceTShaderImpl& kernel) { kernel.run(); },
    .gradient = [](SubtractGradientTShaderImpl& kernel) { kernel.run(); },
    .packing = packVelocity,
};
