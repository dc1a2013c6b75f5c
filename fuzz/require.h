#pragma once

#include <cstdio>
#include <cstdlib>

// Reports an error and aborts, as a sanitizer does, unless `holds`.
inline void require(bool holds, const char* what) {
    if (holds) return;
    std::fprintf(stderr, "ERROR: %s\n", what);
    std::abort();
}
