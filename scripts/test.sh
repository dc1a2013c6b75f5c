#!/usr/bin/env bash
# Builds everything with both compilers, warnings being errors, and passes every test, once as shipped and once under
# the address and undefined behaviour sanitizers.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh
install_missing "${build_packages[@]}" "${test_packages[@]}"

git ls-files '*.cpp' '*.h' | xargs clang-format --dry-run --Werror
for preset in release asan clang; do
    cmake --preset "$preset" -DTIDEMARK_TESTS=ON -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset "$preset"
    ctest --preset "$preset" -j "$(nproc)"
done
scripts/lint.sh
