#pragma once

#include <string>
#include <string_view>

namespace tidemark {

// Returns text from a file in quotes for a message of one line. Long text is truncated; bytes other than printable
// ASCII, which could control a terminal, become \xNN.
std::string quoted(std::string_view text);

}  // namespace tidemark
