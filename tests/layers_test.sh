#!/usr/bin/env bash
# layers_test.sh ROOT: fails if a file includes a folder that is not below its own. The host and everything above it may
# include only the native methods of the library, and the host its vectors; host/engine_window.cpp is the one exception.
set -euo pipefail
cd "$1"
library="base tshader gl water fluid jni"
front_ends="host platform desktop pictures jni/natives.h"
declare -A below=(
    [base]=""
    [tshader]="base"
    [gl]="base"
    [water]="base tshader gl"
    [fluid]="base tshader gl water"
    [jni]="base tshader gl water fluid"
    [platform]=""
    [desktop]=""
    [pictures]="host"
    [host]="platform jni/natives.h base/float4.h base/groups.h"
    [examples]="host"
    [preview]="$front_ends"
    [web]="$front_ends"
    [android]="$front_ends"
    [reference]="$library"
    [probes]="$library host platform"
    [bench]="$library host platform desktop reference probes"
    [fuzz]="$library host platform probes"
    [tests]="$library host platform desktop pictures preview android reference probes"
)
failed=0
while IFS= read -r folder; do
    [ "${below[$folder]+known}" ] || { echo "$folder/ is not in this test" && failed=1; }
done < <(git ls-files '*/*.cpp' '*/*.h' | cut -d/ -f1 | sort -u)
for folder in "${!below[@]}"; do
    allowed=$(tr ' ' '|' <<<"$folder ${below[$folder]}")
    if grep -rnE '#include "[a-z]+/' "$folder" --include='*.h' --include='*.cpp' --include='*.frag' --include='*.vert' \
        --exclude-dir=node_modules | grep -v '^host/engine_window.cpp:.*"jni/globals.h"' |
        grep -vE "#include \"(($allowed)(/|\")|shaders/shaders.h\")"; then
        echo "$folder/ may include $folder ${below[$folder]} only"
        failed=1
    fi
done
exit "$failed"
