#include "bench/allocation_count.h"

#include <cstddef>

static long count = 0;

long allocationCount() {
    return count;
}

// Definitions of the executable come before the C library's, which keeps its own under other names.
extern "C" {

void* __libc_malloc(std::size_t);
void* __libc_calloc(std::size_t, std::size_t);
void* __libc_realloc(void*, std::size_t);

void* malloc(std::size_t size) {
    ++count;
    return __libc_malloc(size);
}

void* calloc(std::size_t number, std::size_t size) {
    ++count;
    return __libc_calloc(number, size);
}

void* realloc(void* block, std::size_t size) {
    ++count;
    return __libc_realloc(block, size);
}
}
