#!/usr/bin/env bash
# Puts what the Android checks take from the platform's sources into build/android-platform: the list of its public API,
# and GLSurfaceView. Debian has them in a source package; nothing of this machine's apt changes.
set -euo pipefail
cd "$(dirname "$0")/.."
platform=$PWD/build/android-platform
[ ! -f "$platform/complete" ] || exit 0
rm -rf "$platform"
mkdir -p "$platform"/{apt,parts,lists}

for sources in /etc/apt/sources.list /etc/apt/sources.list.d/*.{list,sources}; do
    [ ! -f "$sources" ] || sed -E 's/^deb /deb-src /; s/^(Types:).*/\1 deb-src/' "$sources" >"$platform/parts/${sources##*/}"
done
apt=(apt-get -qq -o Dir::Etc::SourceList=/dev/null -o Dir::Etc::SourceParts="$platform/parts"
    -o Dir::State::Lists="$platform/lists" -o Dir::Cache="$platform/apt" -o APT::Sandbox::User=)
"${apt[@]}" update
(cd "$platform" && "${apt[@]}" source --download-only android-platform-frameworks-base)
tar -x -f "$platform"/android-platform-frameworks-base_*.orig.tar.* -C "$platform" \
    api/current.txt opengl/java/android/opengl/GLSurfaceView.java
rm -rf "$platform"/{apt,parts,lists,android-platform-frameworks-base_*}
touch "$platform/complete"
