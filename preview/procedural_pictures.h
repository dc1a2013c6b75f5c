// The pictures that the preview shows when it is given none: a sunlit river bed, upright and across, and the
// light that the water throws back. Always the same pixels.
#pragma once

#include "host/picture.h"

Picture riverBed(int width, int height);
Picture waterLight(int side);
