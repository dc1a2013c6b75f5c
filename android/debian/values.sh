# shellcheck shell=bash
# Sourced by the scripts beside it.

# shellcheck disable=SC2034  # the scripts use it
framework=/usr/share/android-framework-res/framework-res.apk

# gradle_value FILE NAME: prints the value that a build.gradle assigns to a name.
gradle_value() {
    sed -nE "s/^ *$2 = '?([^']*)'?$/\1/p" "$1"
}
