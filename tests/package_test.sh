#!/usr/bin/env bash
# package_test.sh SOURCE BUILD FOLDER: installs the built package into FOLDER, moves it, builds examples/glfw with it and
# runs that under an X server. Fails if the window stays black, does not come to rest, or does not change after a press.
set -euo pipefail
fail() {
    echo "The package $*" >&2
    exit 1
}
if [ "$1" = --on-screen ]; then
    "$2" &
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
rm -rf "$3"
cmake --install "$2" --prefix "$3/first" >/dev/null
mv "$3/first" "$3/installed"
cp -r "$1/examples/glfw" "$3/pool"
cmake -S "$3/pool" -B "$3/build" -DCMAKE_PREFIX_PATH="$3/installed" -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build "$3/build" >/dev/null
xvfb-run -a -s "-screen 0 320x320x24 -noreset" "$0" --on-screen "$3/build/pool"
