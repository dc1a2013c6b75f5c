#pragma once

// a - b as Java's int computes it: a host may report any coordinate, and an overflow of ours would be undefined.
inline int wrappingDifference(int a, int b) {
    return static_cast<int>(static_cast<unsigned>(a) - static_cast<unsigned>(b));
}
