#pragma once

#include <cstddef>
#include <memory>
#include <new>

#include "jni/log.h"

// A buffer that only grows and lives across calls, so that warm frames allocate nothing.
template <class T>
class Scratch {
public:
    explicit Scratch(const char* purpose) : purpose_(purpose) {}

    // Room for `needed` elements with any content, or null, logged once, when there is no memory.
    T* reserve(std::size_t needed) {
        if (needed <= capacity_) return data_.get();
        data_.reset(new (std::nothrow) T[needed]);
        capacity_ = data_ ? needed : 0;
        if (!data_ && !reported_) LOG_ERROR("no memory for %s", purpose_);
        reported_ = !data_;
        return data_.get();
    }

private:
    const char* purpose_;
    std::unique_ptr<T[]> data_;
    std::size_t capacity_ = 0;
    bool reported_ = false;
};
