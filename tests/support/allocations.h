// Counts the C++ allocations of this process, and fails those with std::nothrow on request: the library's.
#pragma once

struct Allocations {
    static inline int made = 0;
    static inline bool fail = false;
};
