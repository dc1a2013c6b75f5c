# shellcheck shell=bash
# Sourced by the scripts beside it.

# shellcheck disable=SC2034  # the scripts use it
framework=/usr/share/android-framework-res/framework-res.apk

# gradle_value FILE NAME: what a module's build.gradle assigns to the name.
gradle_value() {
    sed -nE "s/^ *$2 = '?([^']*)'?$/\1/p" "$1"
}
