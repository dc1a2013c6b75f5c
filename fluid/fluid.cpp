#include "fluid/fluid.h"

Fluid fluid;
