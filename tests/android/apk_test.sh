#!/usr/bin/env bash
# apk_test.sh APK VERSION CLASSES FOLDER: checks the APK's signature for each supported Android, the alignment of its
# libraries, and the names of classes and methods that the platform and the libraries look up. Unpacks the APK into
# FOLDER, with the code as a jar.
set -euo pipefail
apk=$1
version=$2
classes=$3
folder=$4
fail() {
    echo "$apk: $*" >&2
    exit 1
}
rm -rf "$folder" && mkdir "$folder"
apksigner verify --verbose --min-sdk-version 21 -Werr "$apk"
zipalign -c 16384 "$apk" || fail "not aligned to pages of 16 KiB"
! unzip -v "$apk" '*.so' | grep Defl || fail "compressed libraries"

name=com.zor.android.visualeffect.tidemark
about=$(aapt2 dump badging "$apk")
while read -r line; do
    grep -qxE "$line" <<<"$about" || fail "no line $line in: $about"
done <<END
package: name='$name.sample' versionCode='1' versionName='$version'.*
sdkVersion:'21'
targetSdkVersion:'36'
launchable-activity: name='$name.sample.MainActivity'.*
native-code: 'arm64-v8a' 'armeabi-v7a' 'x86_64'
END

unzip -q "$apk" -d "$folder"
[ "$(find "$folder/lib" -name '*.so' | sort | sed 's:.*/lib/::' | tr '\n' ' ')" = "$(
    printf '%s ' {arm64-v8a,armeabi-v7a,x86_64}/libTidemark{Effect,Host}.so)" ] || fail "other libraries than expected"
! llvm-readelf -S "$folder"/lib/*/*.so | grep -E '\.(symtab|debug)' || fail "libraries with symbols"
# The script enjarify would use the first Python in the path, which may lack the module.
/usr/bin/python3 -O -m enjarify.main "$folder/classes.dex" -o "$folder/classes.jar"

natives() {
    javap -p -cp "$1" "$name.JniTidemarkRender" "$name.NativeWater" | grep ' native ' | sed 's/ final / /' | sort
}
diff <(natives "$classes") <(natives "$folder/classes.jar") || fail "other native methods (>) than in the sources (<)"
named=$(aapt2 dump xmltree --file AndroidManifest.xml "$apk" | sed -nE 's/.*:name\(.*"(\.\w+)" \(Raw.*/\1/p')
[ "$named" ] || fail "a manifest without classes"
for class in $named; do
    javap -cp "$folder/classes.jar" "$name.sample$class" >/dev/null || fail "no $class"
done
