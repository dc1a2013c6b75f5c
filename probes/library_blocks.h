// Counts the library's allocations and makes chosen ones fail. CMakeLists.txt in this folder explains how.
#pragma once

struct LibraryBlocks {
    static inline int requested = 0;
    static inline int live = 0;  // allocated and not yet freed
    // Range of requests that fail, numbered from 1.
    static inline int failFirst = 0;
    static inline int failLast = 0;
};
