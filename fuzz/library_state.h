#pragma once

// Resets the library to its state after loading and silences its log.
void resetLibrary();

// Checks the invariants between calls: bitmaps and grids own blocks of at least their size, every velocity is finite,
// and the floating-point modes are those of the host.
void requireValidState();
