#include "pictures/jpeg_tables.h"

#include <cstddef>
#include <numeric>

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::uint8_t kHuffmanTables = 0xc4;
constexpr std::uint8_t kStartOfImage = 0xd8;
constexpr std::uint8_t kStartOfScan = 0xda;

constexpr std::size_t kCounts = 16;  // of codes, one for each length in bits
constexpr int kMostCodes = 256;

// One or more tables: a byte of class and number, the counts, and a byte for each code.
bool haveSoundCounts(Bytes tables) {
    while (tables.size() > kCounts) {
        const Bytes counts = tables.subspan(1, kCounts);
        const int codes = std::accumulate(counts.begin(), counts.end(), 0);
        if (codes > kMostCodes) return false;
        const std::size_t size = 1 + kCounts + static_cast<std::size_t>(codes);
        if (size > tables.size()) return false;
        tables = tables.subspan(size);
    }
    return tables.empty();
}

// Leaves out bytes up to and with the next marker, which is returned; 0 at the end.
std::uint8_t nextMarker(Bytes& rest) {
    std::size_t i = 0;
    while (i < rest.size() && rest[i] != 0xff) ++i;
    while (i < rest.size() && rest[i] == 0xff) ++i;
    const std::uint8_t marker = i < rest.size() ? rest[i] : std::uint8_t{0};
    rest = rest.subspan(i < rest.size() ? i + 1 : i);
    return marker;
}

}  // namespace

bool haveSoundTables(Bytes jpeg) {
    Bytes rest = jpeg;
    if (rest.empty() || rest[0] != 0xff || nextMarker(rest) != kStartOfImage) return true;
    bool scanning = false;
    while (rest.size() > 2) {
        const std::uint8_t marker = nextMarker(rest);
        if (rest.size() < 2) break;
        // Where a scan ends is for its decoder to tell, so from there on every marker counts and nothing is skipped.
        scanning = scanning || marker == kStartOfScan;
        if (scanning && marker != kHuffmanTables) continue;
        const std::size_t length = static_cast<std::size_t>(rest[0] << 8 | rest[1]);
        if (length < 2 || length > rest.size()) return marker != kHuffmanTables;
        if (marker == kHuffmanTables && !haveSoundCounts(rest.subspan(2, length - 2))) return false;
        if (!scanning) rest = rest.subspan(length);
    }
    return true;
}
