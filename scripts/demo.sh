#!/usr/bin/env bash
# Renders the shipped scene into out/: pictures and a short video of a photo under moving water. Arguments go to
# tidemark-preview: scripts/demo.sh --portrait my-photo.jpg
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh
install_missing "${build_packages[@]}"
cmake --preset release -DTIDEMARK_TESTS=OFF >build-demo.log 2>&1 || { cat build-demo.log; exit 1; }
cmake --build --preset release --target tidemark-preview
exec build/release/preview/tidemark-preview --script scenes/demo.touch --out out --video out/demo.mp4 "$@"
