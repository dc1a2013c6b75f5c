#pragma once

#include <string>
#include <string_view>

namespace tidemark {

// Text of a file in quotes for a message of one line: its beginning, with bytes that are not printable ASCII, which a
// terminal might obey, as \xNN.
std::string quoted(std::string_view text);

}  // namespace tidemark
