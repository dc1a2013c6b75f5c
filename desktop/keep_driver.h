#pragma once

// Prevents the current context's Mesa libraries from being unloaded. Reports at process exit, such as a leak checker's,
// can then resolve their symbols, and the next context starts faster.
void keepDriverLoaded();
