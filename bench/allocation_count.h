#pragma once

// Blocks that this process has taken from the heap so far, by any library in it.
long allocationCount();
