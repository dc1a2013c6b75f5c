#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "base/log.h"

// A buffer that is reused across calls and never shrinks, so that frames after the first few allocate nothing.
template <class T>
class Scratch {
public:
    constexpr explicit Scratch(const char* purpose) : purpose_(purpose) {}
    ~Scratch() { std::free(data_); }
    Scratch(const Scratch&) = delete;
    Scratch& operator=(const Scratch&) = delete;

    // Returns `needed` uninitialized elements, or null if the allocation fails. Consecutive failures are logged once.
    T* reserve(std::size_t needed) {
        if (needed <= capacity_) return data_;
        std::free(data_);
        data_ = needed <= SIZE_MAX / sizeof(T) ? static_cast<T*>(std::malloc(needed * sizeof(T))) : nullptr;
        capacity_ = data_ ? needed : 0;
        if (!data_ && !reported_) LOG_ERROR("no memory for %s", purpose_);
        reported_ = !data_;
        return data_;
    }

private:
    const char* purpose_;
    T* data_ = nullptr;
    std::size_t capacity_ = 0;
    bool reported_ = false;
};
