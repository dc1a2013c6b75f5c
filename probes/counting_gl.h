// An OpenGL ES 2.0 that draws nothing: takes the place of the driver's library, counts the calls and succeeds. It
// defines what this library uses and no more, so whatever else is called does not link.
#pragma once

#include <cstddef>
#include <map>
#include <string>

struct GlUse {
    std::map<std::string, int> calls;
    std::size_t bytes = 0;  // handed over by glBufferData and glTexImage2D
};

// Of shaders and programs. It never writes anything into a log.
struct GlCompiler {
    static inline bool succeeds = true;
    static inline int logLength = 0;
};

// What was used since the last call.
GlUse takeGlUse();
