#pragma once

#include <cstdio>
#include <cstdlib>

// Ends the process, as a sanitizer does, where something does not hold.
inline void require(bool holds, const char* what) {
    if (holds) return;
    std::fprintf(stderr, "ERROR: %s\n", what);
    std::abort();
}
