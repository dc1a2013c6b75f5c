// Memory for what the host keeps in containers: the C++ runtime, whose business this is otherwise, does not come along.
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
