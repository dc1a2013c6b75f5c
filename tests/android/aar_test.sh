#!/usr/bin/env bash
# aar_test.sh AAR SOURCE PLATFORM FOLDER: builds the README's layout and Kotlin with the AAR, as an app would, and checks
# the AAR's libraries, resource names and rules.
set -euo pipefail
aar=$1
source=$2
platform=$3
folder=$4
name=com.zor.android.visualeffect.tidemark
fail() {
    echo "$aar: $*" >&2
    exit 1
}
# snippets LANGUAGE
snippets() {
    sed -n "/^\`\`\`$1\$/,/^\`\`\`\$/{/^\`\`\`/!p}" "$source/android/README.md"
}
rm -rf "$folder"
mkdir -p "$folder"/{parts,app/layout,app/drawable,app/raw}
unzip -q "$aar" -d "$folder/parts"
cd "$folder"

[ "$(snippets xml)" ] || fail "the README has no layout"
{
    echo '<FrameLayout xmlns:android="http://schemas.android.com/apk/res/android"
        android:layout_width="match_parent" android:layout_height="match_parent">'
    snippets xml
    echo '</FrameLayout>'
} >app/layout/main.xml
while read -r file; do
    echo '<shape xmlns:android="http://schemas.android.com/apk/res/android" />' >"app/$file"
done < <(grep -oE '@(drawable|raw)/\w+' app/layout/main.xml | sed 's/^@//; s/drawable.*/&.xml/')
echo '<manifest package="com.example.app" />' >manifest.xml
aapt2 compile --dir parts/res -o module.zip
aapt2 compile --dir app -o app.zip
aapt2 link -I /usr/share/android-framework-res/framework-res.apk --manifest manifest.xml --min-sdk-version 21 \
    --output-text-symbols symbols.txt -o linked.apk module.zip app.zip
attributes() {
    grep -oE '(attr|styleable) \w+' "$1" | sort
}
diff <(attributes symbols.txt) <(attributes parts/R.txt) || fail "R.txt has other names (>) than the resources (<)"
javap -cp "parts/classes.jar:$platform" "$name.TidemarkView" |
    grep -q "public .*TidemarkView(android.content.Context, android.util.AttributeSet);" || fail "no view for layouts"
for abi in arm64-v8a armeabi-v7a x86_64; do
    [ "$(cd "parts/jni/$abi" && echo *)" = "libTidemarkEffect.so libTidemarkHost.so" ] || fail "other libraries for $abi"
done
diff parts/proguard.txt "$source/android/tidemark/consumer-rules.pro" || fail "other rules for shrinkers"

kotlin=$folder/../kotlin
mkdir -p "$kotlin"
cp --update "$source"/tests/android/kotlin/package{,-lock}.json "$kotlin"
if [ ! "$kotlin/node_modules/.package-lock.json" -nt "$kotlin/package-lock.json" ]; then
    echo "Going to download the packages of tests/android/kotlin/package-lock.json (90 MB) with npm"
    npm --prefix "$kotlin" ci --no-audit --no-fund
fi
[ "$(snippets kotlin)" ] || fail "the README has no Kotlin"
cat >Snippet.kt <<END
import androidx.compose.ui.viewinterop.AndroidView
import $name.*
$(snippets kotlin | grep '^import ')

fun snippet(picture: Int, withInk: Boolean) {
$(snippets kotlin | grep -v '^import ')
}
END
java -cp "$kotlin/node_modules/kotlin-compiler/lib/kotlin-compiler.jar" org.jetbrains.kotlin.cli.jvm.K2JVMCompiler \
    -kotlin-home "$kotlin/node_modules/kotlin-compiler" -cp "parts/classes.jar:$platform" -d kotlin.jar \
    Snippet.kt "$source"/tests/android/kotlin/*.kt
