#!/usr/bin/env bash
# link_names.sh TRIPLE DIRECTORY: builds libraries to link with, which define the names of Android's libraries at API
# level 21 that our libraries may use. No name is of the C++ runtime.
set -euo pipefail
triple=$1
mkdir -p "$2"
cd "$2"
library() {
    printf 'void %s(void) {}\n' "${@:2}" | clang-14 --target="$triple" -x c -w -fno-builtin -shared -nostdlib \
        -fuse-ld=lld -Wl,-soname,"$1" -o "$1" -
}
mapfile -t gl < <(sed -nE 's/^GL_APICALL .* GL_APIENTRY (gl\w+).*/\1/p' /usr/include/GLES2/gl2.h)
library libGLESv2.so "${gl[@]}"
library liblog.so __android_log_print
library libjnigraphics.so AndroidBitmap_{getInfo,lockPixels,unlockPixels}
library libm.so ceil ceilf cos exp floor floorf lround lroundf pow sin sincos
library libc.so __cxa_atexit abort clock_gettime free lrand48 malloc memcmp memcpy memmove memset realloc strlen \
    __aeabi_{idiv,memclr,memclr4,memclr8,memcpy,memcpy4,memcpy8,memmove,memmove4,memmove8}
