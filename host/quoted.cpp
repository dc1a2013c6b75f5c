#include "host/quoted.h"

#include <cstddef>

namespace tidemark {

std::string quoted(std::string_view text) {
    constexpr std::size_t kLongest = 60;
    constexpr char kDigits[] = "0123456789abcdef";
    std::string result = "\"";
    for (const char c : text.substr(0, kLongest)) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte >= ' ' && byte <= '~') {
            result += c;
        } else {
            result += {'\\', 'x', kDigits[byte / 16], kDigits[byte % 16]};
        }
    }
    return result + (text.size() > kLongest ? "...\"" : "\"");
}

}  // namespace tidemark
