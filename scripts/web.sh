#!/usr/bin/env bash
# Builds the web page into web/dist, one folder that any web server can serve, and serves it at the address that it
# prints. With --build: only builds.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/packages.sh
install_missing "${web_packages[@]}"
# A Node that does not come from Debian brings its own.
command -v npm >/dev/null || install_missing npm

# Debian's emscripten finds its own packages of Node only so.
export NODE_PATH=/usr/share/nodejs
[ -f build/web/build.ninja ] || emcmake cmake -S . -B build/web -G Ninja -Wno-dev -DTIDEMARK_WERROR=ON \
    -DCMAKE_BUILD_TYPE=Release "-DCMAKE_CXX_FLAGS_RELEASE=-O2 -DNDEBUG -msimd128" >/dev/null
cmake --build build/web --target tidemark
cd web
[ node_modules -nt package-lock.json ] || npm ci --no-audit --no-fund
npm run --silent build
[ "${1-}" = --build ] || exec npm run --silent serve
