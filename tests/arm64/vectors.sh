#!/usr/bin/env bash
# vectors.sh PROGRAM: checks in the disassembly that each hot loop uses vectors of four floats. A loop, including the
# parts that the compiler outlined, needs the listed number of fmul and one fadd or fsub on 4s registers.
set -euo pipefail
code=$(aarch64-linux-gnu-objdump --disassemble --demangle --no-show-raw-insn "$1")
# stepWaves: three in accelerate, which is compiled with and without the calm test, and two in smooth.
for loop in "stepWaves 8" "addRipple 1" "packVelocity 1" {AdvectVelocity,AddVelocity,ComputeDivergence,Jacobi,SubtractGradient}"TShaderImpl::run 1"; do
    awk -v name="${loop% *}(" -v least="${loop#* }" '
        /^[0-9a-f]+ <.*>:$/ { in_loop = index($0, name) }
        in_loop && $2 ~ /^f(add|sub)$/ && $3 ~ /^v[0-9]+\.4s,$/ { ++sums }
        in_loop && $2 == "fmul" && $3 ~ /^v[0-9]+\.4s,$/ { ++products }
        END {
            printf "%s): %d vector sums, %d vector products\n", name, sums, products
            exit !(sums && products >= least)
        }' <<<"$code"
done
