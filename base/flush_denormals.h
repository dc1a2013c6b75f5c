// Sets flush-to-zero and denormals-are-zero for the lifetime of the object, then restores the host's floating-point
// mode. Fields that decay end in denormals, which many processors compute with many times more slowly.
#pragma once

#if defined(__SSE2__) && !defined(__EMSCRIPTEN__)
#include <xmmintrin.h>
#else
#include <cstdint>
#endif

class FlushDenormals {
public:
    FlushDenormals() : saved_(get()) { set(saved_ | kFlush); }

    ~FlushDenormals() { set(saved_); }
    FlushDenormals(const FlushDenormals&) = delete;
    FlushDenormals& operator=(const FlushDenormals&) = delete;

private:
#if defined(__SSE2__) && !defined(__EMSCRIPTEN__)
    using Register = unsigned int;
    static constexpr Register kFlush = 0x8040;  // FTZ | DAZ
    static Register get() {
        return _mm_getcsr();
    }
    static void set(Register value) {
        _mm_setcsr(value);
    }
#elif defined(__aarch64__)
    using Register = std::uint64_t;
    static constexpr Register kFlush = Register{1} << 24;  // FZ
    static Register get() {
        Register value;
        __asm__ volatile("mrs %0, fpcr" : "=r"(value));
        return value;
    }
    static void set(Register value) {
        __asm__ volatile("msr fpcr, %0" : : "r"(value) : "memory");
    }
#elif defined(__arm__) && defined(__ARM_FP)
    using Register = std::uint32_t;
    static constexpr Register kFlush = Register{1} << 24;  // FZ, for scalar code; NEON always flushes
    static Register get() {
        Register value;
        __asm__ volatile("vmrs %0, fpscr" : "=r"(value));
        return value;
    }
    static void set(Register value) {
        __asm__ volatile("vmsr fpscr, %0" : : "r"(value) : "memory");
    }
#else
    using Register = std::uint32_t;  // WebAssembly has no such mode
    static constexpr Register kFlush = 0;
    static Register get() {
        return 0;
    }
    static void set(Register) {}
#endif

    Register saved_;
};
