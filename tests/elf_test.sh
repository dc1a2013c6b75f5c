#!/usr/bin/env bash
# elf_test.sh LIBRARY NATIVES_H BYTES [PAGE]: checks the shared library. It exports exactly the native methods that the
# header declares, does not depend on the C++ runtime, has no text relocations, is linked with relro and immediate
# binding, has segments aligned to PAGE, and is at most BYTES long when stripped.
set -euo pipefail
library=$1
most=$3
page=${4-0x1000}
fail() {
    echo "$library: $*" >&2
    exit 1
}
diff <(llvm-nm -D --defined-only "$library" | awk '{print $NF}' | sort) <(grep -o 'Java_[A-Za-z0-9_]*' "$2" | sort) ||
    fail "exports other names (<) than the header declares (>)"
! llvm-nm -D --undefined-only "$library" | awk '{print $NF}' | grep -v '^__cxa_\(atexit\|finalize\)' |
    grep -E '^(_Zn[wa]|_Zd[la]|_ZT|_ZN?K?St|__cxa_|__gxx|_Unwind)' || fail "needs the C++ runtime"
dynamic=$(readelf -dW "$library")
segments=$(readelf -lW "$library")
[[ $dynamic != *TEXTREL* ]] || fail "text relocations"
[[ $dynamic == *BIND_NOW* && $segments == *GNU_RELRO* ]] || fail "not linked with relro and now"
grep -q 'GNU_STACK.* RW ' <<<"$segments" || fail "the stack can be executed"
! grep 'LOAD.* RWE ' <<<"$segments" || fail "writable memory can be executed"
! grep 'LOAD ' <<<"$segments" | grep -v " $page$" || fail "segments that do not begin with a page of $page"
llvm-strip -o "$library.stripped" "$library"
bytes=$(stat -c %s "$library.stripped")
echo "stripped: $bytes bytes"
((bytes <= most)) || fail "more than $most bytes stripped"
