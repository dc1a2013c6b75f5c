#include "probes/library_blocks.h"

#include <cstddef>
#include <cstring>

// ld's option --wrap prescribes these names.
extern "C" {
void* __real_malloc(std::size_t size);
void* __real_realloc(void* block, std::size_t size);
void __real_free(void* block);
void* __wrap_malloc(std::size_t size);
void* __wrap_realloc(void* block, std::size_t size);
void __wrap_free(void* block);
}

static bool fails() {
    const int number = ++LibraryBlocks::requested;
    return number >= LibraryBlocks::failFirst && number <= LibraryBlocks::failLast;
}

void* __wrap_malloc(std::size_t size) {
    void* const block = fails() ? nullptr : __real_malloc(size);
    if (!block) return nullptr;
    ++LibraryBlocks::live;
    return std::memset(block, '?', size);  // makes reads of uninitialized memory visible
}

void* __wrap_realloc(void* block, std::size_t size) {
    if (fails()) return nullptr;
    void* const grown = __real_realloc(block, size);
    if (grown && !block) ++LibraryBlocks::live;
    return grown;
}

void __wrap_free(void* block) {
    if (block) --LibraryBlocks::live;
    __real_free(block);
}
