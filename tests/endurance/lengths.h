// How long to endure: a taste in every run of the tests, all of it where the environment asks for it.
#pragma once

#include <cstdlib>
#include <string_view>

inline bool isFullLength() {
    const char* const wish = std::getenv("TIDEMARK_ENDURANCE");
    return wish && std::string_view(wish) == "full";
}
