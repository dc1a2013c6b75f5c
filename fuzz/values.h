// Generates arguments from the fuzzer's bytes: usually plausible values, so that sessions are long and fast, sometimes
// extreme ones.
#pragma once

#include <fuzzer/FuzzedDataProvider.h>

#include <bit>
#include <cstdint>
#include <limits>

class Values : public FuzzedDataProvider {
public:
    using FuzzedDataProvider::FuzzedDataProvider;

    int below(int end) { return ConsumeIntegralInRange(0, end - 1); }

    int number(int least, int most) {
        const auto kind = ConsumeIntegral<std::uint8_t>();
        if (kind < 208) return ConsumeIntegralInRange(least, most);
        if (kind < 236) return PickValueInArray(kEdges);
        return ConsumeIntegral<int>();
    }

    float real() {
        const auto kind = ConsumeIntegral<std::uint8_t>();
        if (kind < 208) return static_cast<float>(ConsumeIntegralInRange(-32768, 32767)) / 256.0f;
        if (kind < 236) return PickValueInArray(kRealEdges);
        return std::bit_cast<float>(ConsumeIntegral<std::uint32_t>());
    }

private:
    using Int = std::numeric_limits<int>;
    using Float = std::numeric_limits<float>;
    // 65536 is the largest side of a view with ink. A side of 786432 has 65536 grid cells. Floats are exact up to 2^24.
    static constexpr int kEdges[] = {Int::min(), Int::min() + 1, -1,        0,     1,      2,
                                     256,        16384,          65535,     65536, 786432, 1 << 24,
                                     1 << 30,    Int::max() - 1, Int::max()};
    static constexpr float kRealEdges[] = {
        0.0f,         -0.0f,           Float::quiet_NaN(), Float::infinity(),   -Float::infinity(),
        Float::max(), Float::lowest(), Float::min(),       Float::denorm_min(), 1.0e9f,
        0.94f};
};
