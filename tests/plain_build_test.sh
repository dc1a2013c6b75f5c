#!/usr/bin/env bash
# plain_build_test.sh FOLDER: builds a copy of the sources with CMake's defaults, without a network and without the
# packages that only the desktop program, the tests and the benchmarks need. Fails if the build gives a warning, does not
# optimize, or changes a source file.
set -euo pipefail
fail() {
    echo "The plain build $*" >&2
    exit 1
}
rm -rf "$1"
mkdir -p "$1/source"
git ls-files -z | tar --create --null --files-from - | tar --extract --directory "$1/source"
cd "$1"
listing() {
    find source -printf '%p %s %T@\n' | sort
}
before=$(listing)
offline=(unshare --net)
# In a container without the permission to create a network namespace, an unreachable proxy blocks downloads instead.
"${offline[@]}" true 2>/dev/null || offline=(env {http,https}_proxy=http://127.0.0.1:9)
"${offline[@]}" cmake -S source -B build -DCMAKE_DISABLE_FIND_PACKAGE_{glfw3,CLI11}=ON >configured
grep 'The desktop program is left out' configured || fail "does not say what is missing"
"${offline[@]}" cmake --build build --parallel "$(nproc)" >built 2>&1 || fail "fails: $(cat built)"
! grep --after-context 9 'warning:' built || fail "warns"
source/tests/elf_test.sh build/libTidemarkEffect.so source/jni/natives.h 90000
grep -q 'CMAKE_BUILD_TYPE:STRING=Release' build/CMakeCache.txt || fail "is not optimized"
diff <(echo "$before") <(listing) || fail "changes its sources"
