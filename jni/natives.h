// The native methods of com.zor.android.visualeffect.tidemark.JniTidemarkRender: the library's whole interface.
// docs/host.md explains how to write a host; where the two differ, this file is authoritative.
//
// Threads. Call every method, including those without GL calls, on the thread that owns the OpenGL ES 2.0 context. All
// methods share one state without locks.
//
// Order.
//   1. transferPortraitBGBitmap, transferLandscapeBGBitmap, transferWaterBitmap
//   2. onInitSetting, then onInitGPU
//   3. onLoadPortraitBGTextures, onLoadLandscapeBGTextures, onLoadWaterTextures
//   4. initWaters, once per pair of mesh arrays
//   5. in every frame: move and ripple as needed, onTouch for each touch event, onDrawFrame once
// Steps 2 and 3 and onDrawFrame need a current context. Repeat steps 2 and 3 after a context loss, and step 2 for
// another view size or ink mode in the same context.
//
// The caller guarantees, because the library cannot check it and a violation may crash: the thread and the context;
// arrays at least as long as the counts and regions passed with them require; indices of existing vertices; bitmaps
// that stay valid during the transfer.
//
// A wrong order does not crash. Before onInitSetting, onDrawFrame draws no water and logs that once. A program that
// failed to build draws nothing; a picture that was not loaded is black.
//
// No other mistake crashes. If a required array is null, or the VM cannot pin it (an OutOfMemoryError is then pending),
// the call changes nothing, move returns true, and onDrawFrame only sets the viewport and steps the ink. Each method
// logs this once. Coordinates, pressures, sizes and lighting values may have any value. A view of more than 65,536
// pixels per side has no ink. NaN in the mesh arrays stays in them.
#pragma once

#include <jni.h>

extern "C" {

// Copy a picture, after which the bitmap may be recycled. The pixels are read as RGBA8, rows from the top, without
// padding between rows; the bitmap's stride and format are ignored. A failure is logged and keeps the earlier pixels;
// if only the lock fails, the slot has the new bitmap's size.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferPortraitBGBitmap(
    JNIEnv* env, jobject, jobject bitmap);
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferLandscapeBGBitmap(
    JNIEnv* env, jobject, jobject bitmap);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferWaterBitmap(JNIEnv* env, jobject, jobject bitmap);

// Sets the view size in pixels and the ink mode, and creates the three mesh buffers. Call onInitGPU next. Without ink
// only the water is simulated and drawn.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitSetting(
    JNIEnv* env, jobject, jint width, jint height, jboolean withInk);

// Creates the programs and, with ink, the render targets and CPU buffers. With ink it leaves one of the ink's
// framebuffers bound: bind framebuffer 0 and set your own clear colour before you clear the screen. docs/host.md lists
// the GL state after each method.
//
// onInitSetting and onInitGPU delete the objects of an earlier set-up by name. After a context loss your new objects
// may have the same names, so set up the library before you create objects of your own.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitGPU(JNIEnv* env, jobject);

// Upload the pictures transferred last.
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadPortraitBGTextures(JNIEnv* env, jobject);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadLandscapeBGTextures(JNIEnv* env, jobject);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadWaterTextures(JNIEnv* env, jobject);

// Fills positions (3 * vertexCount floats) and indices (6 * (N - 1) * (N - 1) shorts) for a mesh of N x N vertices
// (numDetailsWidth = numDetailsHeight = N, 2 to 256) and meshSizeWidth x meshSizeHeight model units.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_initWaters(
    JNIEnv* env, jobject, jfloatArray positions, jshortArray indices, jint vertexCount, jint meshSizeWidth,
    jint meshSizeHeight, jint numDetailsWidth, jint numDetailsHeight);

// Steps the waves for x in [xStart, xEnd), y in [yStart, yEnd), element y * stride + x of both fields, which must
// include one more element on each side of the region. rowCount is ignored. Returns 1 if every updated speed is within
// +-0.009 or checkCalm is false, else 0; Java may declare the result as boolean or int.
JNIEXPORT jint JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move(
    JNIEnv* env, jobject, jfloatArray velocity, jfloatArray height, jint xStart, jint yStart, jint xEnd, jint yEnd,
    jint stride, jint rowCount, jboolean checkCalm, jfloat damping, jfloat waveSpeed);

// Adds a cone of radius 3 cells and height 3 * amplitude to a field of countA * countB floats, element
// b * countA + a. posA and posB range from -extent / 2 to +extent / 2.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_ripple(
    JNIEnv* env, jobject, jfloatArray field, jint extentA, jint extentB, jint countA, jint countB, jfloat posA,
    jfloat posB, jfloat amplitude);

// Reports a touch event: view pixels from the top left, the action code of android.view.MotionEvent, and the pressure.
// With ink, the next frame injects ink. The distance between two events determines the speed class of a drag: send one
// move per frame while the finger moves, and none while it rests.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onTouch(
    JNIEnv* env, jobject, jint x, jint y, jint action, jfloat pressure);

// Draws one frame over the whole view without clearing: into the current framebuffer without ink, into framebuffer 0
// with ink. positions and heightAttribs hold 3 floats per vertex, indices unsigned vertex numbers, mvp 16 floats,
// column-major. You may pass only the visible part of the mesh; the cost of a frame follows the counts.
//
// With ink, each call also steps the simulation; with counts of 0 it does nothing else. A step calls the process's
// lrand48 twice if the latest touch is more than the margin (10 to 60 pixels) away from every edge. To reproduce a
// recording, seed it with srand48.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onDrawFrame(
    JNIEnv* env, jobject, jfloatArray positions, jfloatArray heightAttribs, jshortArray indices, jint positionFloats,
    jint heightFloats, jint indexCount, jfloatArray mvp, jint meshSizeWidth, jint meshSizeHeight, jint numDetailsWidth,
    jint numDetailsHeight, jfloat refractiveIndex, jfloat alphaMix, jfloat alphaScale1, jfloat alphaScale2,
    jfloat inkRed, jfloat inkGreen, jfloat inkBlue, jfloat fresnelRatio, jfloat specularRatio, jfloat exponent,
    jboolean landscape);

// Returns whether ink is drawn: 1 after a touch or a set-up with ink, 0 after a cancel or clearInkValue. It does not
// tell whether ink remains. 180 frames after the finger is lifted all ink has faded; a host that pauses must count
// them.
JNIEXPORT jint JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_getClearInkValue(JNIEnv* env, jobject);

// Ends the gesture and hides the ink; the next frame clears it.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_clearInkValue(JNIEnv* env, jobject);

}  // extern "C"
