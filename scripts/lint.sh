#!/usr/bin/env bash
# Checks the format, runs static analysis for every language, and compares facts that several files contain. With --fix, only
# formats the C++. Java is checked by its compiler when the tests are built.
set -euo pipefail
cd "$(dirname "$0")/.."
source scripts/common.sh
fix=
if [ "${1-}" = --fix ]; then
    fix=yes
    shift
fi
no_more_arguments "scripts/lint.sh [--fix]" "$@"
install_missing "${build_packages[@]}" "${lint_packages[@]}"

if [ "$fix" ]; then
    git ls-files '*.cpp' '*.h' | xargs clang-format -i
    exit
fi
git ls-files '*.cpp' '*.h' | xargs clang-format --dry-run --Werror
shellcheck -x scripts/*.sh .ci/run tests/*.sh tests/*/*.sh android/debian/*.sh
git ls-files '*.py' | PYTHONPYCACHEPREFIX=build/pycache xargs python3 -m py_compile
# The playground has the package's types from its build.
[ ! -d web/package/dist ] || web/node_modules/.bin/tsc --noEmit -p web
[ ! -d web/node_modules ] || web/node_modules/.bin/tsc --noEmit -p web/package

# One version, that of CMakeLists.txt.
version=$(sed -n 's/^project(Tidemark VERSION \([0-9.]*\) .*/\1/p' CMakeLists.txt)
has_version() {
    grep -qF "$2" "$1" || { echo "$1 lacks $2" >&2 && exit 1; }
}
has_version android/tidemark/build.gradle "version = '$version'"
has_version android/sample/build.gradle "versionName = '$version'"
has_version web/package.json "\"version\": \"$version\""
has_version web/package/package.json "\"version\": \"$version\""
has_version CHANGELOG.md "## [$version]"

# A comment that begins with "What" has no subject; see CONTRIBUTING.md.
if git grep -nIE '(//|#|\*|""")[[:space:]]*What\b' -- ':!*.md' ':!scripts/lint.sh'; then
    echo 'a comment begins with "What"' >&2
    exit 1
fi

# The files with the words "by contract" are those that docs/contract.md lists.
diff <(git grep -il 'by contract' -- '*.cpp' '*.h' '*.vert' '*.frag' | sort) \
    <(grep -oE '[a-z]+/[A-Za-z_]+\.(cpp|h|vert|frag)' docs/contract.md | sort -u)

[ -f build/clang/compile_commands.json ] || cmake --preset clang -DTIDEMARK_TESTS=OFF -DTIDEMARK_BENCH=OFF >/dev/null
git ls-files '*.cpp' ':!'{tests,bench,examples,reference,probes,web,fuzz} |
    xargs -P "$(nproc)" -n 4 clang-tidy -p build/clang --quiet 2> >(grep -v "warnings generated" >&2)
