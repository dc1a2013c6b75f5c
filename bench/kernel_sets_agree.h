#pragma once

// Returns whether every kernel set computes the library's results up to rounding. Prints the first difference.
bool kernelSetsAgree();
