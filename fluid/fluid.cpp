#include "fluid/fluid.h"

#include "fluid/buffers.h"

Fluid fluid;

Fluid::~Fluid() {
    freeBuffers(*this);
}
