#include "host/look_file.h"

#include <cstddef>
#include <sstream>
#include <variant>

#include "host/look_values.h"
#include "host/quoted.h"
#include "host/read_file.h"

namespace tidemark {

namespace {

std::string trimmed(const std::string& text) {
    constexpr char kBlanks[] = " \t\r";
    const std::size_t first = text.find_first_not_of(kBlanks);
    return first == text.npos ? "" : text.substr(first, text.find_last_not_of(kBlanks) + 1 - first);
}

// Applies one line. Returns an empty string if the line is valid, otherwise the reason.
std::string readLine(const std::string& line, Look& look) {
    const std::size_t sign = line.find('=');
    if (sign == line.npos) return "expected \"key = number\"";
    const std::string key = trimmed(line.substr(0, sign));
    const std::string value = trimmed(line.substr(sign + 1));
    const LookField* const field = fieldNamed(key);
    if (!field) return "there is no value " + quoted(key);
    std::istringstream words(value);
    double number = 0.0;
    if (!(words >> number) || !words.eof()) return key + " takes no " + quoted(value);
    if (setValue(look, *field, number)) return "";
    std::ostringstream limits;
    limits << key << " must be " << field->least << " to " << field->most << ", not " << quoted(value);
    if (std::holds_alternative<int Look::*>(field->member)) limits << ", and a whole number";
    return limits.str();
}

}  // namespace

std::optional<Look> parseLook(std::istream& text, const std::string& name, std::string& error, const Look& base) {
    Look look = base;
    std::string line;
    for (int number = 1; std::getline(text, line); ++number) {
        line = trimmed(line);
        if (line.empty() || line[0] == '#') continue;
        const std::string problem = readLine(line, look);
        if (!problem.empty()) {
            error = name + ":" + std::to_string(number) + ": " + problem;
            return std::nullopt;
        }
    }
    return look;
}

std::optional<Look> loadLook(const std::string& path, std::string& error, const Look& base) {
    constexpr std::size_t kMostBytes = 1 << 20;
    const std::optional<std::string> content = readFile(path, "the look", kMostBytes, error);
    if (!content) return std::nullopt;
    std::istringstream text(*content);
    return parseLook(text, path, error, base);
}

}  // namespace tidemark
