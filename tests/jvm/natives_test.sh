#!/usr/bin/env bash
# natives_test.sh JAVA HEADER: Java declares the library's native methods, by name and by the order of the parameters'
# names. Their types are the compiler's to compare.
set -euo pipefail
methods() {
    tr -s '\n ' ' ' | grep -oE "$1\w+\([^)]*\)" |
        sed -E "s/^$1//; s/JNIEnv\* env, jobject(, )?//; s/ *[^(,]* (\w+)([,)])/\1\2/g" | sort
}
diff <(methods 'native \w+ ' <"$1") <(methods 'JniTidemarkRender_' <"$2")
