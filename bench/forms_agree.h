#pragma once

// Whether every form computes what the library computes, up to rounding; prints the first that does not.
bool formsAgree();
