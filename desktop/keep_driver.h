#pragma once

// With a current context, keeps Mesa's libraries in memory after their last use: reports made at the exit of the
// process, such as those of a leak checker, can then name the code that they are about, and the next context starts
// sooner.
void keepDriverLoaded();
