// What the hot loops would be without vectors.
#include <cmath>

void scalarLoops(float* out, const float* in, int count) {
    for (int i = 0; i < count; ++i) out[i] = std::sqrt((in[i] + out[i]) * 0.25f - in[i + 1]);
}
