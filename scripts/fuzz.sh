#!/usr/bin/env bash
# Fuzzes the native methods for the given minutes, on one core. New inputs are stored in build/fuzz/corpus for the next
# run. This command adds those that reach new code to the repository's corpus:
#   build/fuzz/fuzz/fuzz_natives -merge=1 -use_counters=0 fuzz/corpus build/fuzz/corpus
# Inputs that fail are stored in build/fuzz/failures. Move them to fuzz/regressions, under a name that describes the fault.
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
mkdir -p build/fuzz/corpus build/fuzz/failures
build/fuzz/fuzz/fuzz_natives -max_total_time=$((minutes * 60)) -timeout=20 -artifact_prefix=build/fuzz/failures/ \
    build/fuzz/corpus fuzz/corpus fuzz/regressions
