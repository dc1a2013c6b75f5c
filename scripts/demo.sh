#!/usr/bin/env bash
# Renders the demo scene into out/: pictures and a short video. Options are passed to tidemark-preview and override this
# script's. Options for outputs or a window replace the outputs in out/:
# scripts/demo.sh --picture my-photo.jpg --video my.gif
set -euo pipefail
root=$(cd "$(dirname "$0")/.." && pwd)
source "$root/scripts/common.sh"
install_missing "${build_packages[@]}"
(
    cd "$root"
    configure_program
    cmake --build --preset release --target tidemark-preview
) >&2
scene=(--script demo)
size=(--size 720x1280)
output=(--video "$root/out/demo.mp4" --out "$root/out" --every 30 --force)
for option in "$@"; do
    case $option in
        --window | --fullscreen) scene=() size=() output=() ;;
        --size*) size=() ;;
        --video* | --out* | --still* | --fields*) output=() ;;
    esac
done
exec "$root/build/release/preview/tidemark-preview" "${scene[@]}" "${size[@]}" "${output[@]}" "$@"
