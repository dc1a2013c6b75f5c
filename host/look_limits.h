#pragma once

#include "host/look.h"

// The look with every value brought within its limits; one that is not a number takes the lower limit.
Look withinLimits(Look look);
