#include "preview/arguments.h"

#include <algorithm>
#include <charconv>

// More than any screen, and still within what drivers draw.
static constexpr int kLongestSide = 8192;

// Ink of this brightness leaves a channel as it is; brighter ink would light the picture up.
static constexpr float kBrightestChannel = 0.75f;

static std::optional<int> parseWhole(std::string_view text, int base) {
    int value = 0;
    const auto [end, problem] = std::from_chars(text.data(), text.data() + text.size(), value, base);
    if (problem != std::errc() || end != text.data() + text.size() || text.front() == '-') return std::nullopt;
    return value;
}

std::optional<Size> parseSize(std::string_view text) {
    const std::size_t cross = text.find('x');
    if (cross == std::string_view::npos) return std::nullopt;
    const std::optional<int> width = parseWhole(text.substr(0, cross), 10);
    const std::optional<int> height = parseWhole(text.substr(cross + 1), 10);
    if (!width || !height) return std::nullopt;
    if (*width < 1 || *height < 1 || *width > kLongestSide || *height > kLongestSide) return std::nullopt;
    return Size{*width, *height};
}

std::optional<InkColor> parseInkColor(std::string_view text) {
    if (text.size() != 7 || text[0] != '#') return std::nullopt;
    float channels[3];
    for (std::size_t i = 0; i < 3; ++i) {
        const std::optional<int> value = parseWhole(text.substr(1 + 2 * i, 2), 16);
        if (!value) return std::nullopt;
        channels[i] = std::min(static_cast<float>(*value) / 255.0f, kBrightestChannel);
    }
    return InkColor{channels[0], channels[1], channels[2]};
}
