#!/usr/bin/env python3
"""java_api.py JDK JAR: writes the API of Java 11, which is a part of the JDK's compiler, as class files of that version.

Debian's shrinker cannot read the JDK's own class files, which are newer.
"""
import sys
import zipfile

jdk, jar = sys.argv[1:]
with zipfile.ZipFile(jdk + "/lib/ct.sym") as api, zipfile.ZipFile(jar, "w") as classes:
    for name in api.namelist():
        releases, _, path = name.partition("/java.base/")
        if "B" in releases and path.endswith(".sig"):
            content = api.read(name)
            classes.writestr(path.removesuffix(".sig") + ".class", content[:6] + b"\0\x37" + content[8:])
