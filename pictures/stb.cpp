// The bodies of the stb libraries, compiled once.
#include <cstddef>
#include <cstdlib>

// A damaged JPEG makes stb_image use tables that no part of the file has defined, which is harmless where they are
// zero. And a few bytes of a PNG can unpack to thousands of times as many; they get this much.
static constexpr std::size_t kMostUnpackedBytes = std::size_t{1} << 30;

static void* resize(void* block, std::size_t bytes) {
    return bytes <= kMostUnpackedBytes ? std::realloc(block, bytes) : nullptr;
}

#define STBI_MALLOC(bytes) std::calloc(1, bytes)
#define STBI_REALLOC(block, bytes) resize(block, bytes)
#define STBI_FREE(block) std::free(block)
#define STBI_ONLY_PNG
#define STBI_ONLY_JPEG
#define STB_IMAGE_IMPLEMENTATION
#include <stb/stb_image.h>

#define STB_IMAGE_RESIZE_IMPLEMENTATION
#include <stb/stb_image_resize.h>

#define STB_IMAGE_WRITE_IMPLEMENTATION
#include <stb/stb_image_write.h>
