#include "tests/support/allocations.h"

#include <cstdlib>
#include <new>

static void* allocate(std::size_t size) {
    ++Allocations::made;
    return std::malloc(size ? size : 1);
}

void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return size >= Allocations::failFrom ? nullptr : allocate(size);
}

void* operator new[](std::size_t size, const std::nothrow_t& tag) noexcept {
    return operator new(size, tag);
}

// The others are the tests' own; they always succeed.
void* operator new(std::size_t size) {
    void* const block = allocate(size);
    if (!block) std::abort();
    return block;
}

void* operator new[](std::size_t size) {
    return operator new(size);
}

void operator delete(void* block) noexcept {
    std::free(block);
}

void operator delete[](void* block) noexcept {
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept {
    std::free(block);
}

void operator delete[](void* block, std::size_t) noexcept {
    std::free(block);
}
