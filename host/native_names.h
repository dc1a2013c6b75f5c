// The library's native methods under their Java names.
#pragma once

#include "jni/natives.h"

namespace tidemark {

#define TIDEMARK_NATIVE(method) \
    inline constexpr auto& method = Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_##method

namespace native {
TIDEMARK_NATIVE(transferPortraitBGBitmap);
TIDEMARK_NATIVE(transferLandscapeBGBitmap);
TIDEMARK_NATIVE(transferWaterBitmap);
TIDEMARK_NATIVE(onInitSetting);
TIDEMARK_NATIVE(onInitGPU);
TIDEMARK_NATIVE(onLoadPortraitBGTextures);
TIDEMARK_NATIVE(onLoadLandscapeBGTextures);
TIDEMARK_NATIVE(onLoadWaterTextures);
TIDEMARK_NATIVE(initWaters);
TIDEMARK_NATIVE(move);
TIDEMARK_NATIVE(ripple);
TIDEMARK_NATIVE(onTouch);
TIDEMARK_NATIVE(onDrawFrame);
TIDEMARK_NATIVE(getClearInkValue);
TIDEMARK_NATIVE(clearInkValue);
}  // namespace native

#undef TIDEMARK_NATIVE

}  // namespace tidemark
