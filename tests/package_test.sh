#!/usr/bin/env bash
# package_test.sh SOURCE BUILD FOLDER EXAMPLE...: installs the built package into FOLDER, moves it, and builds and runs
# each of the examples with it under an X server. Fails if a window stays black, does not come to rest, or does not
# change after a press.
# A CMAKE_TOOLCHAIN_FILE in the environment is that of another machine, whose programs RUNNER runs.
set -euo pipefail
fail() {
    echo "The package $*" >&2
    exit 1
}
if [ "$1" = --on-screen ]; then
    shift
    "$@" &
    program=$!
    trap 'kill "$program" 2>/dev/null || true' EXIT
    shot() { # the window's middle, as bytes
        ffmpeg -loglevel error -f x11grab -draw_mouse 0 -video_size 200x200 -i "$DISPLAY+60,60" -frames:v 1 \
            -f rawvideo -pix_fmt gray - | base64 --wrap=0
    }
    black=$(head -c 40000 /dev/zero | base64 --wrap=0)
    rest=$black
    for ((tries = 0; tries < 60; ++tries)); do
        kill -0 "$program" || fail "gives a program that ends by itself"
        last=$rest
        sleep 0.5
        rest=$(shot)
        [ "$rest" = "$black" ] || [ "$rest" != "$last" ] || break
    done
    [ "$rest" != "$black" ] || fail "gives a program whose window is black"
    [ "$rest" = "$last" ] || fail "gives a program whose water does not come to rest"
    xdotool mousemove 160 160 click 1
    for ((tries = 0; tries < 20; ++tries)); do
        [ "$(shot)" = "$rest" ] || exit 0
    done
    fail "gives a program that ignores the mouse"
fi
source=$1 build=$2 folder=$3
shift 3
rm -rf "$folder"
cmake --install "$build" --prefix "$folder/first" >/dev/null
mv "$folder/first" "$folder/installed"
ffmpeg -loglevel error -f lavfi -i testsrc2=size=320x320 -frames:v 1 "$folder/photo.png"
for example in "$@"; do
    cp -r "$source/examples/$example" "$folder/$example"
    cmake -S "$folder/$example" -B "$folder/$example/build" -DTidemark_ROOT="$folder/installed" \
        -DCMAKE_FIND_ROOT_PATH="$folder/installed" -DCMAKE_BUILD_TYPE=Release >/dev/null
    cmake --build "$folder/$example/build" >/dev/null
    # shellcheck disable=SC2086  # a runner has arguments
    xvfb-run -a -s "-screen 0 320x320x24 -noreset" "$0" --on-screen ${RUNNER-} "$folder/$example/build/pool" \
        "$folder/photo.png"
done
