#pragma once

namespace tidemark {

// From now on the first SIGINT or SIGTERM is only recorded. A second one ends the program.
void recordInterrupts();
bool interrupted();

}  // namespace tidemark
