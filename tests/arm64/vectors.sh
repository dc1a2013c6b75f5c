#!/usr/bin/env bash
# vectors.sh PROGRAM: whether each hot loop, with what the compiler split from it, computes on vectors of four floats: at
# least that many multiplications, and one addition or subtraction, in Arm's machine code.
set -euo pipefail
code=$(aarch64-linux-gnu-objdump --disassemble --demangle --no-show-raw-insn "$1")
# In the waves, three in the speeds' sweep, which is there with and without the calm test, and two in the smoothing.
for loop in "stepWaves 8" "addRipple 1" "packVelocity 1" {AdvectVelocity,AddVelocity,ComputeDivergence,Jacobi,SubtractGradient}"TShaderImpl::run 1"; do
    awk -v name="${loop% *}(" -v least="${loop#* }" '
        /^[0-9a-f]+ <.*>:$/ { inside = index($0, name) }
        inside && $2 ~ /^f(add|sub)$/ && $3 ~ /^v[0-9]+\.4s,$/ { ++sums }
        inside && $2 == "fmul" && $3 ~ /^v[0-9]+\.4s,$/ { ++products }
        END {
            printf "%s): %d vector sums, %d vector products\n", name, sums, products
            exit !(sums && products >= least)
        }' <<<"$code"
done
