#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>

#include "base/log.h"

// A buffer that only grows and lives across calls, so that warm frames allocate nothing.
template <class T>
class Scratch {
public:
    constexpr explicit Scratch(const char* purpose) : purpose_(purpose) {}
    ~Scratch() { std::free(data_); }
    Scratch(const Scratch&) = delete;
    Scratch& operator=(const Scratch&) = delete;

    // Room for `needed` elements with any content, or null, logged once, when there is no memory.
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
