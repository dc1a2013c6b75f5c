#!/usr/bin/env bash
# has_vectors.sh <objdump> <function> <least> <object>...: whether the function, or what the compiler split from it,
# computes on vectors of four floats: at least that many multiplications, and one addition or subtraction, in the machine
# code.
set -euo pipefail
objdump=$1
function=$2
least=$3
shift 3
"$objdump" --disassemble --demangle --no-show-raw-insn "$@" | awk -v name="$function" -v least="$least" '
    /^[0-9a-f]+ <.*>:$/ { inside = index($0, name "(") > 0 }
    inside && $2 ~ /^f(add|sub)$/ && $3 ~ /^v[0-9]+\.4s,$/ { ++sums }
    inside && $2 == "fmul" && $3 ~ /^v[0-9]+\.4s,$/ { ++products }
    inside && $2 ~ /^f(add|sub|mul)$/ && $3 ~ /^s[0-9]+,$/ { ++scalars }
    END {
        printf "%s: %d vector sums, %d vector products, %d scalar\n", name, sums, products, scalars
        exit !(sums && products >= least)
    }'
