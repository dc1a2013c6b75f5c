#include <GLES2/gl2.h>

#include "base/log.h"
#include "fluid/ink_tuning.h"
#include "jni/bitmaps.h"
#include "jni/gesture.h"
#include "jni/globals.h"
#include "jni/ink_frame.h"
#include "jni/natives.h"
#include "jni/pinned_arrays.h"
#include "water/mesh.h"
#include "water/ripples.h"
#include "water/waves.h"

extern "C" {

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferPortraitBGBitmap(
    JNIEnv* env, jobject, jobject bitmap) {
    transferBitmap(env, bitmap, portraitSlot);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferLandscapeBGBitmap(
    JNIEnv* env, jobject, jobject bitmap) {
    transferBitmap(env, bitmap, landscapeSlot);
}

JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferWaterBitmap(JNIEnv* env, jobject, jobject bitmap) {
    transferBitmap(env, bitmap, waterSlot);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitSetting(
    JNIEnv*, jobject, jint width, jint height, jboolean withInk) {
    SCREEN_WIDTH = width;
    SCREEN_HEIGHT = height;
    bWithInk = withInk;
    LOG_INFO("onInitSetting");
    fluid.InitializeSetting(width, height, bWithInk);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitGPU(JNIEnv*, jobject) {
    fluid.InitializeGPU(bWithInk);
}

JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadPortraitBGTextures(JNIEnv*, jobject) {
    LOG_INFO("onLoadPortraitBGTextures");
    fluid.LoadPortraitBGTextures(bmp_portrait_bg_info, bmp_portrait_bg_Pixels);
}

JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadLandscapeBGTextures(JNIEnv*, jobject) {
    LOG_INFO("onLoadLandscapeBGTextures");
    fluid.LoadLandscapeBGTextures(bmp_landscape_bg_info, bmp_landscapebg_Pixels);
}

JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadWaterTextures(JNIEnv*, jobject) {
    fluid.LoadWaterTextures(bmp_water_Info, bmp_water_Pixels);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_initWaters(
    JNIEnv* env, jobject, jfloatArray positions, jshortArray indices, jint vertexCount, jint meshSizeWidth,
    jint meshSizeHeight, jint numDetailsWidth, jint numDetailsHeight) {
    const int cells = numDetailsWidth > 1 && numDetailsHeight > 1;  // 0, or 1 for "at least one"
    const auto fill = [=](bool complete, jfloat* p, jshort* i) {
        if (!complete) return;
        if (p) fillPositions(p, vertexCount, meshSizeWidth, meshSizeHeight, numDetailsWidth, numDetailsHeight);
        if (i) fillIndices(i, numDetailsWidth, numDetailsHeight);
    };
    withPinned(env, "initWaters", fill, Argument{positions, vertexCount}, Argument{indices, cells});
}

// By contract rowCount is ignored.
JNIEXPORT jint JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move(
    JNIEnv* env, jobject, jfloatArray velocity, jfloatArray height, jint xStart, jint yStart, jint xEnd, jint yEnd,
    jint stride, jint, jboolean checkCalm, jfloat damping, jfloat waveSpeed) {
    bool calm = true;
    const auto advance = [=, &calm](bool complete, jfloat* v, jfloat* h) {
        if (complete) calm = stepWaves(v, h, {xStart, yStart, xEnd, yEnd, stride}, checkCalm, damping, waveSpeed);
    };
    withPinned(env, "move", advance, Argument{velocity, 1}, Argument{height, 1});
    return calm;
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_ripple(
    JNIEnv* env, jobject, jfloatArray field, jint extentA, jint extentB, jint countA, jint countB, jfloat posA,
    jfloat posB, jfloat amplitude) {
    const auto add = [=](bool complete, jfloat* values) {
        if (complete) addRipple({values, extentA, extentB, countA, countB}, posA, posB, amplitude);
    };
    withPinned(env, "ripple", add, Argument{field, 1});
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onTouch(
    JNIEnv*, jobject, jint x, jint y, jint action, jfloat pressure) {
    touch(x, y, action, pressure);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onDrawFrame(
    JNIEnv* env, jobject, jfloatArray positions, jfloatArray heightAttribs, jshortArray indices, jint positionFloats,
    jint heightFloats, jint indexCount, jfloatArray mvp, jint meshSizeWidth, jint meshSizeHeight, jint numDetailsWidth,
    jint numDetailsHeight, jfloat refractiveIndex, jfloat alphaMix, jfloat alphaScale1, jfloat alphaScale2,
    jfloat inkRed, jfloat inkGreen, jfloat inkBlue, jfloat fresnelRatio, jfloat specularRatio, jfloat exponent,
    jboolean landscape) {
    glViewport(0, 0, SCREEN_WIDTH, SCREEN_HEIGHT);
    const auto draw = [=](bool complete, const jfloat* p, const jfloat* h, const jfloat* m, const jshort* i) {
        if (bWithInk) stepInk({inkRed, inkGreen, inkBlue});
        if (!complete) return;
        fluid.Ripple_Render(
            p, h, i, positionFloats, heightFloats, indexCount, m, meshSizeWidth, meshSizeHeight, numDetailsWidth,
            numDetailsHeight, refractiveIndex, alphaMix, alphaScale1, alphaScale2, fresnelRatio, specularRatio,
            exponent, bWithInk, landscape);
    };
    withPinned(
        env, "onDrawFrame", draw, Argument{positions, positionFloats}, Argument{heightAttribs, heightFloats},
        Argument{mvp, 16}, Argument{indices, indexCount});
}

JNIEXPORT jint JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_getClearInkValue(JNIEnv*, jobject) {
    return static_cast<jint>(fluid.ClearInkValue);
}

JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_clearInkValue(JNIEnv*, jobject) {
    state = kIdle;
    step = 0;
    fluid.ClearInkValue = 0.0f;
    fluid.DensityDissipation = 0.0f;  // By contract every frame clears the ink until the next gesture.
    fluid.DragMode = kSlowDrag;
}

}  // extern "C"
