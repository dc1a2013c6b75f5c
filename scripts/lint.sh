#!/usr/bin/env bash
# clang-tidy over the library, the host and the programs, as the clang preset compiles them.
set -euo pipefail
cd "$(dirname "$0")/.."
[ -f build/clang/compile_commands.json ] || cmake --preset clang -DTIDEMARK_WERROR=ON >/dev/null
git ls-files '*.cpp' ':!tests' ':!bench' ':!web' ':!fuzz' | xargs -P "$(nproc)" -n 4 clang-tidy -p build/clang --quiet 2> >(grep -v "warnings generated" >&2)
