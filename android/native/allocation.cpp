// Allocates the memory of the host's containers, because the C++ runtime, which usually does, is not linked.
#include <cstdlib>
#include <new>

void* operator new(std::size_t bytes) {
    void* const block = std::malloc(bytes ? bytes : 1);
    if (!block) std::abort();
    return block;
}

void operator delete(void* block) noexcept {
    std::free(block);
}

void operator delete(void* block, std::size_t) noexcept {
    std::free(block);
}
