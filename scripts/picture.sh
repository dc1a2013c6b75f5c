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
rm -rf out/welcome.mp4 out/inside out/strokes-* out/quality-*

"$preview" --script scenes/welcome.touch --rain --size 1260x708 --seconds 3.8 --video out/welcome.mp4
ffmpeg -v error -y -i out/welcome.mp4 -vf fps=15,scale=840:-1:flags=lanczos \
    -c:v libwebp_anim -quality 55 -compression_level 4 -loop 0 docs/tidemark.webp

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
    "$preview" --script scenes/fast.touch --size 1080x2340 --density 3 --quality "$quality" --seconds 0.85 \
        --every 50 --out "out/quality-$quality"
    parts+=(-i "out/quality-$quality/frame-0001.png")
done
ffmpeg -v error -y "${parts[@]}" -filter_complex \
    "[0]scale=540:-1[a];[1]scale=540:-1[b];[2]scale=540:-1[c];[a][b][c]hstack=inputs=3,crop=1620:700:0:300,scale=1200:-1" \
    -frames:v 1 -c:v libwebp -quality 80 docs/density.webp

parts=()
for preset in clear-lake summer-rain heavy-glass quicksilver honey red-ink deep-swell; do
    "$preview" --preset "$preset" --script scenes/strip.touch --size 360x560 --seconds 1.2 --every 71 --out "out/preset-$preset"
    parts+=(-i "out/preset-$preset/frame-0001.png")
done
ffmpeg -v error -y "${parts[@]}" -filter_complex "hstack=inputs=7,scale=1660:-1" \
    -frames:v 1 -c:v libwebp -quality 80 docs/presets.webp

# Grounds of three brightnesses, each as it is and wet.
"$preview" --ground shore --no-ink --size 400x400 --seconds 0.02 --script scenes/tap.touch --out out/ground
parts=()
for brightness in 0.3 -0.1 -0.4; do
    ffmpeg -v error -y -i out/ground/frame-0000.png -vf "eq=brightness=$brightness:saturation=0.4" "out/ground$brightness.png"
    for wet in 0.0 0.6; do
        echo "wet = $wet" >out/wet.look
        "$preview" --portrait "out/ground$brightness.png" --look out/wet.look --no-ink --script scenes/strip.touch \
            --size 400x400 --seconds 0.5 --every 29 --out "out/wet$brightness$wet"
        parts+=(-i "out/wet$brightness$wet/frame-0001.png")
    done
done
ffmpeg -v error -y "${parts[@]}" -filter_complex "hstack=inputs=6,scale=1660:-1" \
    -frames:v 1 -c:v libwebp -quality 80 docs/wet.webp
