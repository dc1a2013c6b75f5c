#!/usr/bin/env bash
# Renews the pictures of the documents: the moving one of the README, and the inside of one stroke for docs/engine.md.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
no_more_arguments "scripts/picture.sh" "$@"
install_missing "${build_packages[@]}"
[ -f build/release/build.ninja ] || cmake --preset release -DTIDEMARK_TESTS=OFF >/dev/null
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
