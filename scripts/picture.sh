#!/usr/bin/env bash
# Draws the pictures of the documents: the README's animation, the fields of a stroke for docs/engine.md, and the stills.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
no_more_arguments "scripts/picture.sh" "$@"
install_missing "${build_packages[@]}"
configure_program
cmake --build --preset release --target tidemark-preview
preview() {
    build/release/preview/tidemark-preview --force "$@"
}

preview --script welcome --rain 1.9 --size 1260x708 --seconds 3.9 --video out/welcome.mp4
ffmpeg -v error -y -i out/welcome.mp4 -vf fps=15,scale=840:-1:flags=lanczos \
    -c:v libwebp_anim -quality 55 -compression_level 4 -loop 0 docs/tidemark.webp

preview --script curl --size 540x540 --seconds 0.7 --fields out/fields
mkdir -p docs/fields
for name in height velocity density result; do
    ffmpeg -v error -y -i "out/fields/$name.png" -c:v libwebp -quality 85 "docs/fields/$name.webp"
done

# join DOCUMENT FILTER PICTURE...
join() {
    local document=$1 filter=$2 inputs=()
    shift 2
    for picture in "$@"; do inputs+=(-i "$picture"); done
    ffmpeg -v error -y "${inputs[@]}" -filter_complex "$filter" -frames:v 1 -c:v libwebp -quality 80 "docs/$document.webp"
}

# The same stroke at 15, 60 and 144 frames a second.
for fps in 15 60 144; do
    preview --script figure_eight --fps "$fps" --still "out/strokes-$fps.png" --at 2
done
join strokes "hstack=inputs=3,crop=1620:640:0:280,scale=1200:-1" out/strokes-{15,60,144}.png

# The same stroke on a phone at each quality.
for quality in low medium high; do
    preview --script figure_eight --size 1080x2340 --density 3 --quality "$quality" --still "out/quality-$quality.png" --at 1.2
done
join density "[0]scale=540:-1[a];[1]scale=540:-1[b];[2]scale=540:-1[c];[a][b][c]hstack=inputs=3,crop=1620:700:0:300,scale=1200:-1" \
    out/quality-{low,medium,high}.png

for preset in clear-lake summer-rain heavy-glass quicksilver honey red-ink deep-swell; do
    preview --preset "$preset" --script strip --size 360x560 --still "out/$preset.png" --at 1.2
done
join presets "hstack=inputs=7,scale=1660:-1" out/{clear-lake,summer-rain,heavy-glass,quicksilver,honey,red-ink,deep-swell}.png

# Grounds of three brightnesses, each as it is and wet.
preview --picture shore --no-ink --size 400x400 --still out/ground.png --at 0.02
for brightness in 0.3 -0.1 -0.4; do
    ffmpeg -v error -y -i out/ground.png -vf "eq=brightness=$brightness:saturation=0.4" "out/ground$brightness.png"
    for wet in 0.0 0.6; do
        echo "wet = $wet" >out/wet.look
        preview --portrait "out/ground$brightness.png" --look out/wet.look --no-ink --script strip --size 400x400 \
            --still "out/wet$brightness$wet.png" --at 0.5
    done
done
join wet "hstack=inputs=6,scale=1660:-1" out/wet{0.3,-0.1,-0.4}{0.0,0.6}.png
