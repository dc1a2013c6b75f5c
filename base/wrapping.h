#pragma once

// a - b modulo 2^32, as Java's int computes it. A host may report any coordinate, and signed overflow is undefined.
inline int wrappingDifference(int a, int b) {
    return static_cast<int>(static_cast<unsigned>(a) - static_cast<unsigned>(b));
}
