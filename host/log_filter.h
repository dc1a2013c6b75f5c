// Keeps the library's log quiet: only failures still reach standard error.
#pragma once

namespace tidemark {

void quietenLog();

}  // namespace tidemark
