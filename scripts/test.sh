#!/usr/bin/env bash
# Builds everything with both compilers, warnings being errors, and passes every test, once as shipped and once under
# the address and undefined behaviour sanitizers; then fuzzes for some seconds. With --arm64: builds the loops over many
# numbers for 64-bit Arm instead, looks for vector arithmetic in the machine code, and compares the results, computed in
# an emulator, with this machine's bit for bit. With --web: builds the web page instead and tries it in Chromium.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh

if [ "${1-}" = --arm64 ]; then
    install_missing "${build_packages[@]}" "${test_packages[@]}" "${arm64_packages[@]}"
    cmake -S tests/arm64 -B build/arm64 -G Ninja -DTIDEMARK_WERROR=ON -DCMAKE_BUILD_TYPE=Release \
        "-DCMAKE_CXX_FLAGS_RELEASE=-O2 -DNDEBUG" -DCMAKE_TOOLCHAIN_FILE="$PWD/cmake/aarch64-linux-gnu.cmake" >/dev/null
    cmake --build build/arm64
    cmake --preset release -DTIDEMARK_TESTS=ON -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset release --target results
    tests/arm64/vectors.sh build/arm64/results
    diff <(build/release/tests/arm64/results) <(qemu-aarch64 -L /usr/aarch64-linux-gnu build/arm64/results)
    echo "The results are those of this machine, bit for bit."
    exit
fi

if [ "${1-}" = --web ]; then
    install_missing "${build_packages[@]}" "${web_test_packages[@]}"
    [ -f build/release/build.ninja ] || cmake --preset release -DTIDEMARK_TESTS=OFF >/dev/null
    cmake --build --preset release --target tidemark-preview
    scripts/web.sh --build
    npm --prefix web test
    exit
fi

install_missing "${build_packages[@]}" "${test_packages[@]}" "${fuzz_packages[@]}"
git ls-files '*.cpp' '*.h' | xargs clang-format --dry-run --Werror
for preset in release asan clang; do
    cmake --preset "$preset" -DTIDEMARK_TESTS=ON -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset "$preset"
done
cmake --preset fuzz -DTIDEMARK_WERROR=ON >/dev/null
cmake --build --preset fuzz
ctest --preset release -j "$(nproc)"
ctest --preset asan -j "$(nproc)"
ctest --preset fuzz -j "$(nproc)"
# Java, the screen and long sessions are about contracts which no compiler changes.
ctest --preset clang -j "$(nproc)" --exclude-regex "^(jvm|window|endurance)"
scripts/lint.sh
