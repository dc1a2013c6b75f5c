// Does not compile where Java declares other types than the host for Java defines.
#include "android/native/water_jni.cpp"  // NOLINT(bugprone-suspicious-include)
#include "com_zor_android_visualeffect_tidemark_NativeWater.h"
