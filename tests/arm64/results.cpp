// Prints a hash of the results of every hot loop for fixed inputs. If two processors print the same lines, their
// results are equal bit for bit.
//
// The inputs avoid results that may differ between processors: the sign and payload of a NaN, and numbers next to the
// smallest normal, which some processors flush to zero before rounding and others after.
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <limits>
#include <span>

#include "base/flush_denormals.h"
#include "reference/ink_grid.h"
#include "reference/surface.h"
#include "water/mesh.h"

namespace {

// Prints the FNV-1a hash of the bytes.
template <class T>
void print(const char* what, const std::vector<T>& values) {
    std::uint64_t hash = 0xcbf29ce484222325u;
    for (const std::byte byte : std::as_bytes(std::span(values))) {
        hash = (hash ^ static_cast<std::uint64_t>(byte)) * 0x100000001b3u;
    }
    std::printf("%-16s %016llx\n", what, static_cast<unsigned long long>(hash));
}

void printWater(int n, float damping) {
    Surface water(n);
    for (const float nowhere : {3.0e38f, std::numeric_limits<float>::quiet_NaN()}) {
        addRipple({water.height.data(), 32, 32, n, n}, nowhere, nowhere, 1.0f);
    }
    std::vector<char> calm;
    for (int i = 0; i < 200; ++i) {
        if (i % 20 == 0) addRipple({water.height.data(), 32, 32, n, n}, 0.31f * static_cast<float>(i) - 16, 3.7f, 0.9f);
        calm.push_back(
            stepWaves(water.velocity.data(), water.height.data(), {1, 1, n - 1, n - 1, n}, true, damping, 0.32f));
    }
    print("water velocity", water.velocity);
    print("water height", water.height);
    print("water calm", calm);
}

void printMesh(int n) {
    std::vector<float> positions(static_cast<std::size_t>(3 * n * n));
    std::vector<std::int16_t> indices(static_cast<std::size_t>(6 * (n - 1) * (n - 1)));
    fillPositions(positions.data(), n * n, 32, 32, n, n);
    fillIndices(indices.data(), n, n);
    print("mesh positions", positions);
    print("mesh indices", indices);
}

void printInk(int viewWidth, int viewHeight, int drag) {
    InkGrid ink(viewWidth, viewHeight);
    ink.advect.drag = drag;
    // Samples far outside the grid, where the conversion to int would be undefined without the clamp.
    ink.velocity[7] = {-3.0e38f, 3.0e38f};
    ink.wholeFrame(kLibrary);
    print("advection", ink.advected);
    print("divergence", ink.divergence);
    print("pressure", ink.pressure);
    print("gradient", ink.projected);
    print("packing", ink.bytes);
    print("forcing", ink.pushed);
}

void printDenormals() {
    const volatile float smallest = std::numeric_limits<float>::min();
    std::vector<float> halves;
    {
        const FlushDenormals flush;
        halves.push_back(smallest * 0.5f);
    }
    halves.push_back(smallest * 0.5f);
    print("denormals", halves);
}

}  // namespace

int main() {
    printMesh(37);
    printWater(37, 0.985f);
    printWater(64, 0.94f);
    printInk(41 * 12, 33 * 12, 2);
    printInk(90 * 12, 160 * 12, 0);
    printDenormals();
}
