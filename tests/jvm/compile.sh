#!/usr/bin/env bash
# compile.sh SOURCE BINARY: compiles the classes that ship, against the platform's API and resources, and the tests.
set -euo pipefail
source=$1
cd "$2"
platform=$PWD/android-platform
"$source/scripts/android_platform.sh" "$platform"
rm -rf classes framework generated resources && mkdir -p classes generated resources
java() {
    find "$@" -name '*.java'
}
compile() {
    "$JAVAC" -Xlint:all,-options -Werror "$@"
}
mapfile -t shipped < <(java "$source/android" "$source/examples")
mapfile -t tests < <(java "$source/tests/jvm/java")

# The framework's own view, without what it keeps from apps: tracing and names of errors. Its surface comes by a test.
mkdir framework
sed '/UnsupportedAppUsage/d; /Trace\.trace/d; /android\.os\.Trace/d; /holder.addCallback/d
    s/EGLLogWrapper.getErrorString(error)/error/' \
    "$platform/opengl/java/android/opengl/GLSurfaceView.java" >framework/GLSurfaceView.java
mapfile -t fakes < <(java "$source/tests/jvm/fakes" framework)

"$PYTHON" "$source/tests/jvm/platform/classes_of_api.py" "$platform/api/current.txt" generated "${shipped[@]}" "${fakes[@]}"
mapfile -t generated < <(java generated)
"$JAVAC" -nowarn -Xlint:none --release 8 -d classes/platform "${generated[@]}"

# Gradle writes the package and the versions into the manifest.
sed 's/<manifest /&package="com.zor.android.visualeffect.tidemark.sample" /
    s/<application/<uses-sdk android:minSdkVersion="21" android:targetSdkVersion="29" \/>&/' \
    "$source/android/sample/src/main/AndroidManifest.xml" >resources/manifest.xml
for module in tidemark sample; do
    "$AAPT2" compile --dir "$source/android/$module/src/main/res" -o resources/$module.zip
done
"$AAPT2" link -I /usr/share/android-framework-res/framework-res.apk --manifest resources/manifest.xml \
    -o resources/linked.apk --java resources --extra-packages com.zor.android.visualeffect.tidemark resources/*.zip

mapfile -t shipped < <(java "$source/android" "$source/examples" resources)
compile --release 8 -h headers -cp "classes/platform:$ANNOTATIONS" -d classes/shipped "${shipped[@]}"
compile --release 8 -cp classes/platform -d classes/fakes "${fakes[@]}"
compile --release 17 -h headers -cp "classes/fakes:classes/platform:classes/shipped:$JUNIT" -d classes/tests "${tests[@]}"
