#include "pictures/jpeg_file.h"

#include <cstddef>
#include <numeric>

namespace {

using Bytes = std::span<const std::uint8_t>;

constexpr std::uint8_t kHuffmanTables = 0xc4;
constexpr std::uint8_t kStartOfImage = 0xd8;
constexpr std::uint8_t kStartOfScan = 0xda;

constexpr std::size_t kCounts = 16;  // of codes, one for each length in bits
constexpr int kMostCodes = 256;

// Encoders write about ten, with each bit of each channel in a scan of its own less than fifty.
constexpr int kMostScans = 100;

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

const char* harmIn(Bytes jpeg) {
    Bytes rest = jpeg;
    if (rest.empty() || rest[0] != 0xff || nextMarker(rest) != kStartOfImage) return nullptr;
    int scans = 0;
    while (rest.size() > 2) {
        const std::uint8_t marker = nextMarker(rest);
        if (rest.size() < 2) break;
        if (marker == kStartOfScan && ++scans > kMostScans) return "it has too many scans";
        // Where a scan ends is for its decoder to tell, so from there on every marker counts and nothing is skipped.
        if (scans > 0 && marker != kHuffmanTables) continue;
        const std::size_t length = static_cast<std::size_t>(rest[0] << 8 | rest[1]);
        const bool isWhole = length >= 2 && length <= rest.size();
        if (marker == kHuffmanTables && !(isWhole && haveSoundCounts(rest.subspan(2, length - 2)))) {
            return "its Huffman tables are corrupt";
        }
        if (!isWhole) break;
        if (scans == 0) rest = rest.subspan(length);
    }
    return nullptr;
}
