#include "tests/endurance/library_blocks.h"

#include <cstddef>
#include <new>

// The names are the linker's.
extern "C" {
void* __real_malloc(std::size_t size);
void* __real_realloc(void* block, std::size_t size);
void __real_free(void* block);
void* __real__ZnamRKSt9nothrow_t(std::size_t size, const std::nothrow_t& tag);
void __real__ZdaPv(void* block);
void* __wrap_malloc(std::size_t size);
void* __wrap_realloc(void* block, std::size_t size);
void __wrap_free(void* block);
void* __wrap__ZnamRKSt9nothrow_t(std::size_t size, const std::nothrow_t& tag);
void __wrap__ZdaPv(void* block);
}

static bool fails() {
    const int number = ++LibraryBlocks::requested;
    return number >= LibraryBlocks::failFirst && number <= LibraryBlocks::failLast;
}

static void* given(void* block) {
    if (block) ++LibraryBlocks::live;
    return block;
}

static void* givenBack(void* block) {
    if (block) --LibraryBlocks::live;
    return block;
}

void* __wrap_malloc(std::size_t size) {
    return fails() ? nullptr : given(__real_malloc(size));
}

void* __wrap_realloc(void* block, std::size_t size) {
    if (fails()) return nullptr;
    void* const grown = __real_realloc(block, size);
    if (grown && !block) ++LibraryBlocks::live;
    return grown;
}

void __wrap_free(void* block) {
    __real_free(givenBack(block));
}

// new (std::nothrow) T[n] and delete[]
void* __wrap__ZnamRKSt9nothrow_t(std::size_t size, const std::nothrow_t& tag) {
    return fails() ? nullptr : given(__real__ZnamRKSt9nothrow_t(size, tag));
}

void __wrap__ZdaPv(void* block) {
    __real__ZdaPv(givenBack(block));
}
