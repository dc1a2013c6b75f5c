// The native methods of com.zor.android.visualeffect.tidemark.JniTidemarkRender: the library's whole interface.
// docs/host.md tells how to write a host around them; where the two differ, this file counts.
//
// Threads. Call every method, also those without GL, on the one thread that owns the OpenGL ES 2.0 context. The
// library locks nothing, and all methods share one state.
//
// Order.
//   1. transferPortraitBGBitmap, transferLandscapeBGBitmap, transferWaterBitmap
//   2. onInitSetting, then onInitGPU
//   3. onLoadPortraitBGTextures, onLoadLandscapeBGTextures, onLoadWaterTextures
//   4. initWaters, once for the mesh arrays
//   5. for every frame: move and ripple as the animation asks, onTouch for each touch event, onDrawFrame once
// Steps 2 and 3 and onDrawFrame need the context to be current. After the context was lost, repeat steps 2 and 3; for
// another view size or another mode in the same context, step 2.
//
// The caller guarantees: the thread and the context; arrays at least as long as the counts and regions passed with them
// ask for; indices that name vertices which exist; bitmaps that stay valid during their hand-over. The library cannot
// see these, and a mistake in them may crash.
//
// The caller also keeps the order, but a mistake there crashes nothing: before onInitSetting, onDrawFrame draws no
// water and says so in the log once. A program that failed to build draws nothing; a picture that was not loaded is
// black.
//
// Any other mistake is harmless. A null array of which the call would use elements, or one that the virtual machine
// cannot pin (its OutOfMemoryError is then pending), makes the call change nothing, move return true and onDrawFrame
// leave out the water: it still sets the viewport and steps the ink. The log says so once for each method. Coordinates,
// pressures, sizes and lighting values may be anything: a view of more than 65,536 pixels a side gets no ink, and a
// value in the mesh arrays that is not a number stays in them.
#pragma once

#include <jni.h>

extern "C" {

// Copy a picture: 32-bit RGBA, rows from the top, without padding between rows, whatever the bitmap's record says of
// its stride and format. The bitmap may be recycled afterwards. A failure is logged and leaves the earlier pixels in
// place; where only the lock failed, the slot has the new bitmap's size.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferPortraitBGBitmap(
    JNIEnv* env, jobject, jobject bitmap);
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferLandscapeBGBitmap(
    JNIEnv* env, jobject, jobject bitmap);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_transferWaterBitmap(JNIEnv* env, jobject, jobject bitmap);

// Fixes the view size in pixels and the mode, and makes the three buffers of the mesh. onInitGPU must follow.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitSetting(
    JNIEnv* env, jobject, jint width, jint height, jboolean withInk);

// Makes the programs and, with ink, its render targets and CPU buffers. With ink it leaves bound what it made last: one
// of the ink's framebuffers, a viewport of the ink's size, the clear colour 0, 0, 0, 0, and the blend function
// GL_SRC_ALPHA, GL_ONE_MINUS_SRC_ALPHA. Bind framebuffer 0 and set your own clear colour before you clear the screen.
//
// Both methods delete the objects that an earlier set-up made, by their names. After a lost context these names may by
// chance be those of new objects: set the library up before you make objects of your own.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onInitGPU(JNIEnv* env, jobject);

// Upload the pictures taken over last.
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadPortraitBGTextures(JNIEnv* env, jobject);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadLandscapeBGTextures(JNIEnv* env, jobject);
JNIEXPORT void JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onLoadWaterTextures(JNIEnv* env, jobject);

// Fills positions, 3 * vertexCount floats, and indices, 6 * (N - 1) * (N - 1) shorts, for a mesh of N x N vertices
// (numDetailsWidth = numDetailsHeight = N, 2 to 256) that spans meshSizeWidth x meshSizeHeight model units.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_initWaters(
    JNIEnv* env, jobject, jfloatArray positions, jshortArray indices, jint vertexCount, jint meshSizeWidth,
    jint meshSizeHeight, jint numDetailsWidth, jint numDetailsHeight);

// One wave step over x in [xStart, xEnd), y in [yStart, yEnd) of the two fields, element y * stride + x. The fields
// must reach one element beyond the region on each side. rowCount is ignored. True when every updated speed lies
// within +-0.009, or when checkCalm is false: a whole 1 or 0, so that Java may declare boolean or int.
JNIEXPORT jint JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_move(
    JNIEnv* env, jobject, jfloatArray velocity, jfloatArray height, jint xStart, jint yStart, jint xEnd, jint yEnd,
    jint stride, jint rowCount, jboolean checkCalm, jfloat damping, jfloat waveSpeed);

// Adds a cone of radius 3 cells and peak 3 * amplitude to a field of countA * countB floats, element
// b * countA + a. posA and posB run from -extent / 2 to +extent / 2.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_ripple(
    JNIEnv* env, jobject, jfloatArray field, jint extentA, jint extentB, jint countA, jint countB, jfloat posA,
    jfloat posB, jfloat amplitude);

// Takes one touch event: pixels of the view from the top left, the action code of android.view.MotionEvent, and the
// pressure. Drops ink with the next frame when the ink is on. The distance between two touches decides the kind of
// stroke: give it one move for each frame while the finger moves, and none while it rests.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onTouch(
    JNIEnv* env, jobject, jint x, jint y, jint action, jfloat pressure);

// Draws one frame over the whole view and clears nothing: without ink into the current framebuffer, with ink into
// framebuffer 0, which the ink's passes bind. With ink, each call is also one step of the ink, and with counts of 0
// nothing else. From the first touch on, each step whose latest touch lies farther than the margin (10 to 60 pixels)
// from every edge draws two numbers of the process's lrand48: seed it with srand48 to repeat a recording. positions and
// heightAttribs hold 3 floats a vertex, indices unsigned vertex numbers, mvp 16 floats by columns.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_onDrawFrame(
    JNIEnv* env, jobject, jfloatArray positions, jfloatArray heightAttribs, jshortArray indices, jint positionFloats,
    jint heightFloats, jint indexCount, jfloatArray mvp, jint meshSizeWidth, jint meshSizeHeight, jint numDetailsWidth,
    jint numDetailsHeight, jfloat refractiveIndex, jfloat alphaMix, jfloat alphaScale1, jfloat alphaScale2,
    jfloat inkRed, jfloat inkGreen, jfloat inkBlue, jfloat fresnelRatio, jfloat specularRatio, jfloat exponent,
    jboolean landscape);

// Whether ink is shown, not whether any is left: 1 after a touch and after a set-up with ink, 0 after a cancel or
// clearInkValue. Ink fades by itself: 180 frames after the finger was lifted none is left. A host that wants to rest
// counts these frames.
JNIEXPORT jint JNICALL
Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_getClearInkValue(JNIEnv* env, jobject);

// Clears the ink with the next frame, and ends the gesture.
JNIEXPORT void JNICALL Java_com_zor_android_visualeffect_tidemark_JniTidemarkRender_clearInkValue(JNIEnv* env, jobject);

}  // extern "C"
