#pragma once

namespace tidemark {

// From now on Ctrl-C, or a request to end, is only noted. A second one ends the program.
void noteInterrupts();
bool interrupted();

}  // namespace tidemark
