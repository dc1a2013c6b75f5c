#!/usr/bin/env bash
# layers_test.sh ROOT: fails on an include of a folder that does not stand below the one that includes it.
set -euo pipefail
cd "$1"
declare -A below=(
    [base]=""
    [tshader]="base"
    [gl]="base"
    [water]="base tshader gl"
    [fluid]="base tshader gl water"
    [jni]="base tshader gl water fluid"
    [platform]=""
    [host]="platform"
)
failed=0
for folder in "${!below[@]}"; do
    allowed=$(tr ' ' '|' <<<"$folder ${below[$folder]}")
    [ "$folder" != host ] || allowed+='|jni/natives.h'
    if grep -rnE '#include "[a-z]+/' "$folder" --include='*.h' --include='*.cpp' --include='*.frag' --include='*.vert' |
        grep -vE "#include \"($allowed)(/|\")" | grep -v '"shaders/shaders.h"'; then
        echo "$folder/ may include $folder ${below[$folder]} only"
        failed=1
    fi
done
exit "$failed"
