// The library's native methods under their Java names.
#pragma once

#include "jni/natives.h"

#define NATIVE(method) Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_##method
