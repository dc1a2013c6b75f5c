#!/usr/bin/env bash
# Renews the picture of the README: six moments of the demo's video side by side.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
no_more_arguments "scripts/picture.sh" "$@"
scripts/demo.sh
inputs=()
for second in 0.55 0.95 1.50 2.6 3.9 5.3; do
    inputs+=(-ss "$second" -i out/demo.mp4)
done
ffmpeg -v error -y "${inputs[@]}" -filter_complex hstack=inputs=6,scale=1440:-1 -frames:v 1 -q:v 5 docs/tidemark.jpg
