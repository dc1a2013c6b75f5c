// The library's global state before and after the calls of one execution.
#pragma once

// Back to what a freshly loaded library has, without log lines.
void resetLibrary();

// What must hold between any two calls: pictures and grids own blocks of the size that they claim, the flow of the ink
// is made of numbers, and the processor's floating-point modes are the host's.
void requireSoundLibrary();
