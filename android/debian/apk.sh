#!/usr/bin/env bash
# apk.sh SOURCE BINARY: packs the sample and signs it with a key that the first build creates. A phone installs an update
# only if it has the same key.
set -euo pipefail
source=$1
here=$(dirname "$0")
cd "$2"
rm -rf apk && mkdir apk

# Classes with native methods are shrunk by the module's rules alone. The others are kept, because tests run them.
python3 "$here/java_api.py" "$JDK" java_api.jar
proguard -include "$source/android/tidemark/consumer-rules.pro" -include resources/rules.pro \
    -injars classes/shipped -outjars apk/classes.jar -libraryjars "java_api.jar:classes/platform:classes/annotations" \
    -keep 'class !**.JniTidemarkRender,!**.NativeWater,com.zor.android.visualeffect.tidemark.* { *; }' \
    -keepclassmembers 'class **.JniTidemarkRender { <init>(); }' \
    -target 1.7 -dontnote -forceprocessing
"$JDK/bin/java" -cp dx.jar com.android.dx.command.Main --dex --min-sdk-version=21 --output=apk/classes.dex \
    apk/classes.jar

cp resources/linked.apk apk/packed.apk
ln -s ../jni apk/lib
(cd apk && zip -q -X packed.apk classes.dex && zip -q -X -0 packed.apk lib/*/*.so)
zipalign 16384 apk/packed.apk apk/aligned.apk
password=(-storepass android)
[ -f key.jks ] || "$JDK/bin/keytool" -genkeypair -keystore key.jks "${password[@]}" -alias tidemark -keyalg RSA \
    -keysize 2048 -validity 10000 -dname CN=Tidemark
apksigner sign --ks key.jks --ks-pass pass:android --out tidemark-sample.apk apk/aligned.apk
rm -f tidemark-sample.apk.idsig
