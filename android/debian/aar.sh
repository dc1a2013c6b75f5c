#!/usr/bin/env bash
# aar.sh SOURCE BINARY: packs the module for apps: classes, resources, libraries, and rules for their shrinkers.
set -euo pipefail
source=$1
# shellcheck source=android/debian/values.sh
source "$(dirname "$0")/values.sh"
cd "$2"
module=$source/android/tidemark
rm -rf aar tidemark.aar && mkdir aar

package=$(gradle_value "$module/build.gradle" namespace)
cat >aar/AndroidManifest.xml <<END
<?xml version="1.0" encoding="utf-8"?>
<manifest xmlns:android="http://schemas.android.com/apk/res/android" package="$package">
    <uses-sdk android:minSdkVersion="$(gradle_value "$module/build.gradle" minSdk)" />
</manifest>
END
aapt2 link -I "$framework" --manifest aar/AndroidManifest.xml --static-lib --output-text-symbols aar/R.txt \
    -o aar/linked.apk resources/tidemark.zip
rm aar/linked.apk
# The build of an app creates the classes R.
(cd classes/shipped && zip -q -X -r ../../aar/classes.jar "${package//./\/}" -x '*/sample/*' '*/R.class' '*/R$*.class')
cp -r "$module/src/main/res" jni aar
cp "$module/consumer-rules.pro" aar/proguard.txt
(cd aar && zip -q -X -r ../tidemark.aar .)
