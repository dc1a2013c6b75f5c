// Keeps the library's log quiet: only failures still reach standard error.
#pragma once

void quietenLog();
