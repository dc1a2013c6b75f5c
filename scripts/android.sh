#!/usr/bin/env bash
# Builds the sample app, out/tidemark-sample.apk, and the library for apps, out/tidemark.aar, with Debian's packages of
# Android's tools. It needs no SDK, NDK or Gradle.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
no_more_arguments "scripts/android.sh" "$@"
install_missing "${build_packages[@]}" "${android_packages[@]}"
configure_program
cmake --build --preset release --target android_packages
mkdir -p out
cp build/release/android/debian/tidemark{-sample.apk,.aar} out
echo "The app and the library: $PWD/out"
echo "Onto a phone: adb install $PWD/out/tidemark-sample.apk (never seen on one so far, nor in an emulator)"
