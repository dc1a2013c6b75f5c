#!/usr/bin/env bash
# compile.sh SOURCE SHIPPED: compiles the example, the tests and the fakes of the platform into the current folder, with
# the classes of android/debian in SHIPPED.
set -euo pipefail
source=$1
shipped=$2
rm -rf classes headers
java() {
    find "$@" -name '*.java'
}
compile() {
    "$JDK/bin/javac" -Xlint:all,-options -Werror "$@"
}
mapfile -t example < <(java "$source/examples")
mapfile -t fakes < <(java "$source/tests/jvm/fakes")
mapfile -t tests < <(java "$source/tests/jvm/java")
platform=$shipped/classes/platform
compile --release 8 -cp "$platform:$shipped/classes/shipped" -d classes/tests "${example[@]}"
compile --release 8 -cp "$platform" -d classes/fakes "${fakes[@]}"
compile --release 17 -h headers -cp "classes/tests:classes/fakes:$platform:$shipped/classes/shipped:$shipped/classes/annotations:$JUNIT" \
    -d classes/tests "${tests[@]}"
