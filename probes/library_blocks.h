// The memory that the library itself asks for, counted and failed on request. The linker puts these functions between
// the program's objects and the allocators; see CMakeLists.txt beside this file.
#pragma once

struct LibraryBlocks {
    static inline int requested = 0;
    static inline int live = 0;  // given out and not yet given back
    // Requests that get nothing, by their number from 1.
    static inline int failFirst = 0;
    static inline int failLast = 0;
};
