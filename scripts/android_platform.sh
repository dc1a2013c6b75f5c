#!/usr/bin/env bash
# android_platform.sh FOLDER: downloads what the Android checks need of the platform's sources into FOLDER: the list of its
# public API, and GLSurfaceView. Debian has them in a source package. The machine's apt configuration does not change.
set -euo pipefail
platform=$1
[ ! -f "$platform/complete" ] || exit 0
rm -rf "$platform"
mkdir -p "$platform"/{apt,parts,lists}

for sources in /etc/apt/sources.list /etc/apt/sources.list.d/*.{list,sources}; do
    [ ! -f "$sources" ] || sed -E 's/^deb /deb-src /; s/^(Types:).*/\1 deb-src/' "$sources" >"$platform/parts/${sources##*/}"
done
apt=(apt-get -qq -o Dir::Etc::SourceList=/dev/null -o Dir::Etc::SourceParts="$platform/parts"
    -o Dir::State::Lists="$platform/lists" -o Dir::Cache="$platform/apt" -o APT::Sandbox::User=)
"${apt[@]}" update
echo "Going to download the source package android-platform-frameworks-base (45 MB) with apt-get"
(cd "$platform" && "${apt[@]}" source --download-only android-platform-frameworks-base)
tar -x -f "$platform"/android-platform-frameworks-base_*.orig.tar.* -C "$platform" \
    api/current.txt opengl/java/android/opengl/GLSurfaceView.java
rm -rf "$platform"/{apt,parts,lists,android-platform-frameworks-base_*}
touch "$platform/complete"
