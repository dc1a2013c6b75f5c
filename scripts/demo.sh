#!/usr/bin/env bash
# Renders the shipped scene into out/: pictures and a short video of moving water. Options go to tidemark-preview, which
# refuses what it does not know: scripts/demo.sh --portrait my-photo.jpg
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
[ "${1-}" != --help ] || no_more_arguments "scripts/demo.sh [OPTION OF build/release/preview/tidemark-preview]..." "$@"
install_missing "${build_packages[@]}"
configure_program
cmake --build --preset release --target tidemark-preview
build/release/preview/tidemark-preview --script scenes/demo.touch --size 720x1280 \
    --out out --every 30 --video out/demo.mp4 "$@"
echo "Pictures and a video: $PWD/out"
