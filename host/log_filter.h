// Passes only the library's failures to standard error.
#pragma once

namespace tidemark {

void quietenLog();

}  // namespace tidemark
