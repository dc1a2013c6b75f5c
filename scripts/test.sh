#!/usr/bin/env bash
# Builds everything, warnings being errors, and passes every test. Takes the parts that are named, or all of them:
#   --native  lint, then both compilers on this machine: as shipped, under the address and undefined behaviour
#             sanitizers, and some seconds of fuzzing
#   --arm64   64-bit Arm: vector arithmetic in the machine code of the loops over many numbers, and results, computed in
#             an emulator, that equal this machine's bit for bit; examples/glfw with the package, in the emulator
#   --android the sample's APK and the module's AAR: signature, names and pages; the APK's code and libraries run; an
#             app's layout and Kotlin build with the AAR
#   --web     the package for web pages and the playground, in Chromium, and the playground in Firefox and WebKitGTK
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
parts=()
while [[ "${1-}" =~ ^--(native|arm64|android|web)$ ]]; do
    parts+=("${BASH_REMATCH[1]}")
    shift
done
no_more_arguments "scripts/test.sh [--native] [--arm64] [--android] [--web]" "$@"
[ ${#parts[@]} -gt 0 ] || parts=(native arm64 android web)

test_native() {
    install_missing "${build_packages[@]}" "${lint_packages[@]}" "${test_packages[@]}" "${fuzz_packages[@]}" \
        "${bench_packages[@]}"
    scripts/lint.sh
    cmake --preset release -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset release
    cmake --preset sanitizers -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset sanitizers
    cmake --preset clang -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset clang --target TidemarkEffect tidemark_{,counting_,gl_,host_}tests
    cmake --preset fuzz -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset fuzz
    tests/plain_build_test.sh build/plain
    # The benchmarks' forms agree with the library's, and each runs; how fast, scripts/bench.sh measures.
    build/release/bench/tidemark_bench --benchmark_min_time=0 >/dev/null
    ctest --preset release -j "$(nproc)" --label-exclude android
    # The driver's precision changes nothing that a sanitizer sees, and another optimizer nothing but numbers.
    ctest --preset sanitizers -j "$(nproc)" --exclude-regex "^(half|exact)"
    ctest --preset fuzz -j "$(nproc)"
    ctest --preset clang -j "$(nproc)" --tests-regex "^(driverless|counting|full|elf)"
}

test_arm64() (
    install_missing "${build_packages[@]}" "${arm64_packages[@]}"
    (
        cd tests/arm64
        cmake --preset arm64 >/dev/null
        cmake --build --preset arm64
        cmake --preset arm64-reference >/dev/null
        cmake --build --preset arm64-reference
    )
    tests/arm64/vectors.sh build/arm64/results
    build/arm64-reference/results >build/arm64-reference/results.txt
    qemu-aarch64 -L /usr/aarch64-linux-gnu build/arm64/results >build/arm64/results.txt
    diff build/arm64-reference/results.txt build/arm64/results.txt
    echo "The results are those of this machine, bit for bit."

    export ARM64_ROOT=$PWD/build/arm64-root CMAKE_TOOLCHAIN_FILE=$PWD/cmake/aarch64-linux-gnu.cmake
    if [ ! -d "$ARM64_ROOT" ]; then
        rm -rf "$ARM64_ROOT.part"
        mkdir -p "$ARM64_ROOT.part"
        mmdebstrap --quiet --variant=extract --architectures=arm64 --include="$arm64_root_packages" bookworm - |
            tar -x -C "$ARM64_ROOT.part" --no-same-owner --exclude="./dev/*"
        mv "$ARM64_ROOT.part" "$ARM64_ROOT"
    fi
    cmake -S . -B build/arm64-package -G Ninja -DCMAKE_BUILD_TYPE=Release >/dev/null
    cmake --build build/arm64-package --target TidemarkEffect tidemark_host
    RUNNER="qemu-aarch64 -L $ARM64_ROOT" tests/package_test.sh . build/arm64-package build/arm64-package/examples glfw
)

test_android() {
    install_missing "${build_packages[@]}" "${test_packages[@]}" "${android_packages[@]}" "${android_test_packages[@]}"
    command -v npm >/dev/null || install_missing npm
    cmake --preset release -DTIDEMARK_BENCH=OFF -DTIDEMARK_WERROR=ON >/dev/null
    cmake --build --preset release
    scripts/android.sh
    ctest --preset release -j "$(nproc)" --label-regex android
}

test_web() {
    install_missing "${build_packages[@]}" "${web_test_packages[@]}"
    configure_program
    cmake --build --preset release --target tidemark-preview
    scripts/web.sh --build
    npm --prefix web test
}

for part in "${parts[@]}"; do
    "test_$part"
done
