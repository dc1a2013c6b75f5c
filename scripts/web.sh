#!/usr/bin/env bash
# Builds the npm package into web/package/dist and the playground into web/dist, one folder that any web server can
# serve, and serves it at the address that it prints. With --build: only builds.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
serve=yes
if [ "${1-}" = --build ]; then
    serve=
    shift
fi
no_more_arguments "scripts/web.sh [--build]" "$@"
install_missing "${web_packages[@]}"
# A Node that does not come from Debian brings its own.
command -v npm >/dev/null || install_missing npm

fetch_packages() {
    [ ! web/node_modules -nt web/package-lock.json ] || return 0
    echo "Going to download the packages of web/package-lock.json with npm"
    npm --prefix web ci --no-audit --no-fund
}
fetch_packages &
cmake --preset web >/dev/null
cmake --build --preset web
wait $!
cd web
npm run --silent build
[ ! "$serve" ] || exec npm run --silent serve
