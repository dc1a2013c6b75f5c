#!/usr/bin/env bash
# Fuzzes the native methods and the preview's files for the given minutes, both at once, each on one core. Inputs that
# reach new code are kept in build/fuzz/corpus for the next run. An input that fails is left in build/fuzz/failures: copy
# it to fuzz/regressions, under a name that tells what is wrong.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
usage="scripts/fuzz.sh MINUTES"
minutes=
if [[ "${1-}" =~ ^[1-9][0-9]*$ ]]; then
    minutes=$1
    shift
fi
no_more_arguments "$usage" "$@"
[ "$minutes" ] || refuse "$usage" "no number of minutes"
install_missing "${build_packages[@]}" "${fuzz_packages[@]}"
cmake --preset fuzz >/dev/null
cmake --build --preset fuzz

failures=build/fuzz/failures
mkdir -p "$failures"
declare -A runs
for target in natives files; do
    corpus=build/fuzz/corpus/$target
    mkdir -p "$corpus"
    options=(-max_total_time=$((minutes * 60)) -timeout=20 -artifact_prefix="$failures/$target-")
    [ ! -f fuzz/$target.dict ] || options+=("-dict=fuzz/$target.dict")
    build/fuzz/fuzz/fuzz_$target "${options[@]}" \
        "$corpus" fuzz/seeds/$target fuzz/regressions/$target >"build/fuzz/$target.log" 2>&1 &
    runs[$target]=$!
done
failed=0
for target in natives files; do
    if wait "${runs[$target]}"; then
        echo "$target: nothing found. $(grep DONE "build/fuzz/$target.log")"
    else
        echo "$target: a failure, in $failures; its report ends build/fuzz/$target.log"
        failed=1
    fi
done
exit "$failed"
