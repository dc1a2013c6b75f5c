#include "preview/arguments.h"

#include <algorithm>
#include <charconv>

namespace {

// More than any screen, and still within what drivers draw.
constexpr int kLongestSide = 8192;

// Ink of this brightness leaves a channel as it is; brighter ink would light the picture up.
constexpr float kBrightestChannel = 0.75f;

std::optional<int> parseWhole(std::string_view text, int base) {
    int value = 0;
    const auto [end, problem] = std::from_chars(text.data(), text.data() + text.size(), value, base);
    if (problem != std::errc() || end != text.data() + text.size() || text.front() == '-') return std::nullopt;
    return value;
}

// A side of the view in pixels, 0 for what is none.
int parseSide(std::string_view text) {
    const int side = parseWhole(text, 10).value_or(0);
    return side <= kLongestSide ? side : 0;
}

}  // namespace

std::optional<Size> parseSize(std::string_view text, std::string& error) {
    const std::size_t cross = std::min(text.find('x'), text.size());
    const Size size = {parseSide(text.substr(0, cross)), parseSide(text.substr(std::min(cross + 1, text.size())))};
    if (size.width > 0 && size.height > 0) return size;
    error = std::string(text) + " is not WIDTHxHEIGHT with sides of 1 to " + std::to_string(kLongestSide) + " pixels";
    return std::nullopt;
}

std::optional<InkColor> parseInkColor(std::string_view text, std::string& error) {
    float channels[3];
    bool sound = text.size() == 7 && text[0] == '#';
    for (std::size_t i = 0; sound && i < 3; ++i) {
        const std::optional<int> value = parseWhole(text.substr(1 + 2 * i, 2), 16);
        channels[i] = std::min(static_cast<float>(value.value_or(0)) / 255.0f, kBrightestChannel);
        sound = value.has_value();
    }
    if (sound) return InkColor{channels[0], channels[1], channels[2]};
    error = std::string(text) + " is not #rrggbb";
    return std::nullopt;
}
