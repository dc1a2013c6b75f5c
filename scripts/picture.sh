#!/usr/bin/env bash
# Renews the pictures of the documents: the moving one of the README, and the inside of one stroke for docs/engine.md.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
no_more_arguments "scripts/picture.sh" "$@"
install_missing "${build_packages[@]}"
configure_program
cmake --build --preset release --target tidemark-preview
preview=build/release/preview/tidemark-preview

# Drawn larger than it is shown, which keeps it crisp.
"$preview" --script scenes/welcome.touch --size 840x504 --seconds 4.8 --video out/welcome.mp4
ffmpeg -v error -y -i out/welcome.mp4 -vf fps=20,scale=480:-1:flags=lanczos \
    -c:v libwebp_anim -quality 55 -compression_level 6 -loop 0 docs/tidemark.webp

"$preview" --script scenes/curl.touch --size 540x540 --seconds 0.7 --inside out/inside
mkdir -p docs/inside
for name in height velocity density result; do
    ffmpeg -v error -y -i "out/inside/$name.png" -c:v libwebp -quality 85 "docs/inside/$name.webp"
done

# The same stroke at 15, 60 and 144 frames a second.
parts=()
for fps in 15 60 144; do
    "$preview" --script scenes/figure_eight.touch --fps "$fps" --seconds 2 --every $((2 * fps - 1)) --out "out/strokes-$fps"
    parts+=(-i "out/strokes-$fps/frame-0001.png")
done
ffmpeg -v error -y "${parts[@]}" -filter_complex "hstack=inputs=3,crop=1620:640:0:280,scale=1200:-1" \
    -frames:v 1 -c:v libwebp -quality 80 docs/strokes.webp

# The same stroke on a phone at each quality.
parts=()
for quality in low medium high; do
    "$preview" --script scenes/welcome.touch --size 1080x2340 --density 3 --quality "$quality" --seconds 1.6 \
        --every 95 --out "out/quality-$quality"
    parts+=(-i "out/quality-$quality/frame-0001.png")
done
ffmpeg -v error -y "${parts[@]}" -filter_complex \
    "[0]scale=540:-1[a];[1]scale=540:-1[b];[2]scale=540:-1[c];[a][b][c]hstack=inputs=3,crop=1620:700:0:300,scale=1200:-1" \
    -frames:v 1 -c:v libwebp -quality 80 docs/density.webp

for vertices in 96 128 192 256; do
    echo "meshVertices = $vertices" >"out/$vertices.look"
    "$preview" --look "out/$vertices.look" --script scenes/quality.touch --size 1440x900 --seconds 0.45 --no-ink \
        --every 26 --out "out/quality-$vertices"
done
parts=()
for vertices in 96 128 192 256; do
    parts+=(-i "out/quality-$vertices/frame-0001.png")
done
crop=crop=360:360:540:300
ffmpeg -v error -y "${parts[@]}" \
    -filter_complex "[0]${crop}[a];[1]${crop}[b];[2]${crop}[c];[3]${crop}[d];[a][b][c][d]hstack=inputs=4" \
    -frames:v 1 -c:v libwebp -quality 88 docs/quality.webp
