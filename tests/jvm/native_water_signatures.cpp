// Does not compile if Java declares other types for a method than the host for Java does.
#include "android/native/water_jni.cpp"  // NOLINT(bugprone-suspicious-include)
#include "com_zor_android_visualeffect_tidemark_NativeWater.h"
