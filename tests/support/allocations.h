// Counts the C++ allocations of this process and fails them on request. The library allocates with new (std::nothrow),
// so a failure gives it null.
#pragma once

struct Allocations {
    static inline int made = 0;
    static inline bool fail = false;
};
