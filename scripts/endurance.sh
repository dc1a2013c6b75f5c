#!/usr/bin/env bash
# Runs the endurance tests at full length: a day of simulated use, a thousand context losses. With --sanitizers, uses the
# sanitizers' build. Takes minutes.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
preset=release
if [ "${1-}" = --sanitizers ]; then
    preset=sanitizers
    shift
fi
no_more_arguments "scripts/endurance.sh [--sanitizers]" "$@"
install_missing "${build_packages[@]}" "${test_packages[@]}" "${fuzz_packages[@]}"

cmake --preset "$preset" -DTIDEMARK_BENCH=OFF -DTIDEMARK_WERROR=ON >/dev/null
cmake --build --preset "$preset" --target tidemark_endurance tidemark_counting_tests
# As in CMakePresets.json.
export TIDEMARK_ENDURANCE=full ASAN_OPTIONS=allocator_may_return_null=1
"build/$preset/tests/endurance/tidemark_endurance"
"build/$preset/tests/tidemark_counting_tests" --gtest_filter='LongRun.*'
