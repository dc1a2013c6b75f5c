#!/usr/bin/env bash
# Builds the benchmarks with both compilers, runs them in turn, and writes docs/bench.md and docs/bench.svg. With --web:
# measures the package in Chromium instead, and writes docs/bench-page.md.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
if [ "${1-}" = --web ]; then
    shift
    no_more_arguments "scripts/bench.sh --web" "$@"
    install_missing chromium
    scripts/web.sh --build
    cmake --build --preset web --target tidemark-water-named
    echo "Going to download jquery and jquery.ripples with npm"
    npm --prefix build/web/peer install --no-save --no-audit --no-fund jquery@3 jquery.ripples@0.6.3
    cd web
    exec node bench/run.mjs ../build/web/peer ../docs/bench-page.md
fi
no_more_arguments "scripts/bench.sh [--web]" "$@"
install_missing "${build_packages[@]}" "${bench_packages[@]}"

declare -A compilers=([gcc]=g++ [clang]=clang++)
for name in gcc clang; do
    cmake --preset release -B "build/bench-$name" -DCMAKE_CXX_COMPILER="${compilers[$name]}" \
        -DTIDEMARK_TESTS=OFF >/dev/null
    cmake --build "build/bench-$name" --target tidemark_bench tidemark_bench_driver
done

out=build/bench-results
rm -rf "$out"
mkdir -p "$out"
options=(--benchmark_format=json --benchmark_repetitions=14 --benchmark_enable_random_interleaving=true)
for round in 1 2 3; do
    for name in gcc clang; do
        "build/bench-$name/bench/tidemark_bench" "${options[@]}" --benchmark_min_time=0.01 >"$out/$name-$round.json"
    done
done
build/bench-gcc/bench/tidemark_bench_driver "${options[@]}" --benchmark_repetitions=3 --benchmark_min_time=0.1 >"$out/driver.json"
python3 bench/report.py "$out" docs
