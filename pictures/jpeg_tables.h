#pragma once

#include <cstdint>
#include <span>

// Whether no Huffman table of a JPEG names more codes than there are byte values. stb_image counts on that: its tables
// are written beyond their ends otherwise. True for what is no JPEG.
bool haveSoundTables(std::span<const std::uint8_t> jpeg);
