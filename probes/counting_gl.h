// A fake OpenGL ES 2.0 library: counts calls, draws nothing and reports success. It defines only the functions that the
// library uses, so a call to any other function fails to link.
#pragma once

#include <cstddef>
#include <map>
#include <string>

struct GlUse {
    std::map<std::string, int> calls;
    std::size_t bytes = 0;  // uploaded by glBufferData and glTexImage2D
};

// Results of compiling shaders and linking programs. Info logs are never written.
struct GlCompiler {
    static inline bool succeeds = true;
    static inline int logLength = 0;
};

// Returns the use since the last call.
GlUse takeGlUse();
