// Counts the C++ allocations of this process, and fails large ones with std::nothrow on request: the library's
// buffers. The driver allocates so as well, but little at a time.
#pragma once

#include <cstddef>
#include <cstdint>

struct Allocations {
    static inline int made = 0;
    static inline std::size_t failFrom = SIZE_MAX;  // bytes
};
