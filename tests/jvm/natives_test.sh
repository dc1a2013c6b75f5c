#!/usr/bin/env bash
# natives_test.sh JAVA HEADER: expects Java to declare the library's native methods, with parameters of the same names in
# the same order. The compiler compares their types, in signatures.cpp.
set -euo pipefail
methods() {
    tr -s '\n ' ' ' | grep -oE "$1\w+\([^)]*\)" |
        sed -E "s/^$1//; s/JNIEnv\* env, jobject(, )?//; s/ *[^(,]* (\w+)([,)])/\1\2/g" | sort
}
diff <(methods 'native \w+ ' <"$1") <(methods 'JniTidemarkRender_' <"$2")
