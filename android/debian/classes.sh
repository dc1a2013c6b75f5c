#!/usr/bin/env bash
# classes.sh SOURCE BINARY: compiles the module and the sample against the platform's API and resources.
set -euo pipefail
source=$1
here=$(dirname "$0")
# shellcheck source=android/debian/values.sh
source "$here/values.sh"
cd "$2"
rm -rf classes generated headers resources
mkdir -p classes/annotations generated resources
java() {
    find "$@" -name '*.java'
}

mapfile -t users < <(java "$source"/android/{tidemark,sample}/src "$source"/{examples,tests/jvm/fakes})
python3 "$here/classes_of_api.py" platform/api/current.txt generated "${users[@]}"
mapfile -t api < <(java generated)
"$JDK/bin/javac" -nowarn -Xlint:none --release 8 -d classes/platform "${api[@]}"
# The annotations are not in the packages: only compilers and editors read them.
mapfile -t annotations < <(java "$here/annotations")
"$JDK/bin/javac" -Xlint:-options --release 8 -d classes/annotations "${annotations[@]}"

# As Gradle does, add the package and the versions of build.gradle to the manifest.
module=$source/android/tidemark
sample=$source/android/sample
sed "s/<manifest /&package=\"$(gradle_value "$sample/build.gradle" namespace)\" /" \
    "$sample/src/main/AndroidManifest.xml" >resources/manifest.xml
aapt2 compile --dir "$module/src/main/res" -o resources/tidemark.zip
aapt2 compile --dir "$sample/src/main/res" -o resources/sample.zip
aapt2 link -I "$framework" --manifest resources/manifest.xml \
    --min-sdk-version "$(gradle_value "$sample/build.gradle" minSdk)" \
    --target-sdk-version "$(gradle_value "$sample/build.gradle" targetSdk)" \
    --version-code "$(gradle_value "$sample/build.gradle" versionCode)" \
    --version-name "$(gradle_value "$sample/build.gradle" versionName)" \
    --java resources --extra-packages "$(gradle_value "$module/build.gradle" namespace)" \
    --proguard resources/rules.pro -o resources/linked.apk resources/{tidemark,sample}.zip

mapfile -t sources < <(java "$module/src" "$sample/src" resources)
"$JDK/bin/javac" -Xlint:all,-options -Werror --release 8 -h headers -cp "classes/platform:classes/annotations" \
    -d classes/shipped "${sources[@]}"
