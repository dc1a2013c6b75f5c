// The methods as Java declares them beside the methods as the library does: other types do not compile.
#include "com_zor_android_visualeffect_tidemark_JniTidemarkRender.h"
#include "jni/natives.h"
