#pragma once

#include <cstdint>
#include <span>

// Why a JPEG must not be read, null for one that may be and for what is no JPEG. stb_image writes beyond the ends of
// its tables where a Huffman table names more codes than there are byte values, and each scan of a progressive picture
// goes over all of it: a small file of very many would take minutes.
const char* harmIn(std::span<const std::uint8_t> jpeg);
