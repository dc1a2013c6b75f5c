package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

/**
 * The native library's whole interface, for which {@code jni/natives.h} has the last word. Most apps want
 * {@link TidemarkView}, which makes these calls in the right order. All objects of this class share
 * one effect.
 *
 * <p><b>Threads.</b> The library takes no lock: call every method on the one thread that owns the OpenGL ES 2.0
 * context, which is the GL thread of a {@code GLSurfaceView}, and forward touches to it with {@code queueEvent}.
 *
 * <p><b>Order.</b>
 * <ol>
 * <li>{@link #transferPortraitBGBitmap}, {@link #transferLandscapeBGBitmap}, {@link #transferWaterBitmap}
 * <li>{@link #onInitSetting}, then {@link #onInitGPU}
 * <li>{@link #onLoadPortraitBGTextures}, {@link #onLoadLandscapeBGTextures}, {@link #onLoadWaterTextures}
 * <li>{@link #initWaters} once for the mesh arrays
 * <li>for every frame {@link #move} and {@link #ripple} as the animation asks, {@link #onTouch} for each touch event,
 * {@link #onDrawFrame} once
 * </ol>
 * After the context was lost, or for another view size or mode, repeat the second and the third step; the third only
 * where the context is a new one.
 *
 * <p><b>The mesh.</b> N x N vertices in the plane z = 0, N from 2 to 256, stored column by column from the left, each
 * column from the top. Model x runs to the right and y upwards, from minus to plus half the mesh's size; the eye is 30
 * units away. The arrays belong to the caller. Lengths and counts are the caller's word: a short array crashes.
 *
 * <p>{@code docs/look.md} gives the ranges in which the numbers of {@link #move}, {@link #ripple} and
 * {@link #onDrawFrame} look well.
 */
public final class JniTidemarkRender {
    static {
        System.loadLibrary("TidemarkEffect");
    }

    /**
     * Takes over the background for portrait. The pixels are copied: the bitmap may be recycled afterwards.
     * A failure is logged and leaves the earlier picture in place.
     *
     * @param bitmap of the configuration ARGB_8888, without padding between its rows, 1 pixel to the driver's largest
     *     texture a side; stretched over the view, so best cropped to its proportions before
     */
    public native void transferPortraitBGBitmap(Bitmap bitmap);

    /**
     * As {@link #transferPortraitBGBitmap}, for landscape.
     *
     * @param bitmap likewise
     */
    public native void transferLandscapeBGBitmap(Bitmap bitmap);

    /**
     * As {@link #transferPortraitBGBitmap}, for the light on the waves.
     *
     * @param bitmap likewise, of any proportions
     */
    public native void transferWaterBitmap(Bitmap bitmap);

    /**
     * Fixes the size and the mode; {@link #onInitGPU} must follow.
     *
     * @param width of the view in pixels, 1 to the driver's largest viewport; with ink at least 12
     * @param height of the view in pixels, likewise
     * @param withInk whether touches drop ink into the water; without, ink costs nothing
     */
    public native void onInitSetting(int width, int height, boolean withInk);

    /** Makes programs, render targets and buffers of the size and the mode set last. */
    public native void onInitGPU();

    /** Uploads the background for portrait that was taken over last. */
    public native void onLoadPortraitBGTextures();

    /** Uploads the background for landscape that was taken over last. */
    public native void onLoadLandscapeBGTextures();

    /** Uploads the picture of the light that was taken over last. */
    public native void onLoadWaterTextures();

    /**
     * Fills the arrays of a flat mesh.
     *
     * @param positions receives x, y, z of every vertex in model units; 3 * vertexCount floats
     * @param indices receives two triangles a cell, as unsigned vertex numbers; 6 * (N - 1) * (N - 1) shorts
     * @param vertexCount vertices to fill, N * N
     * @param meshSizeWidth extent along x in model units, at least 1
     * @param meshSizeHeight likewise along y
     * @param numDetailsWidth vertices along x, N
     * @param numDetailsHeight too
     */
    public native void initWaters(float[] positions, short[] indices, int vertexCount, int meshSizeWidth,
            int meshSizeHeight, int numDetailsWidth, int numDetailsHeight);

    /**
     * Takes one wave step over a rectangle of the two fields, N * N floats each with element {@code y * stride + x}.
     * The elements around it are read and not changed: at least one on every side. On the mesh x and {@code stride}
     * count down a column, y across the columns.
     *
     * @param velocity speeds in model units a step
     * @param height heights in model units; kept within -100 to 100
     * @param xStart first x, at least 1
     * @param yStart first y, likewise
     * @param xEnd one past the last x, at most N - 1
     * @param yEnd one past the last y, likewise
     * @param stride elements from one y to the next, N
     * @param rowCount ignored; N
     * @param checkCalm whether to look for calm
     * @param damping factor on every speed, 0 to 1; 0.94 exactly also smooths the surface more
     * @param waveSpeed factor on the curvature, 0 to 0.5, above which waves blow up
     * @return true when every speed lies within -0.009 to 0.009 after the step, and always without {@code checkCalm}
     */
    public native boolean move(float[] velocity, float[] height, int xStart, int yStart, int xEnd, int yEnd, int stride,
            int rowCount, boolean checkCalm, float damping, float waveSpeed);

    /**
     * Adds a cone of three cells' radius to a field. The two outermost elements on the near sides and the outermost one
     * on the far sides stay as they are. On the mesh a counts down a column and b across the columns.
     *
     * @param field heights (or speeds) in model units, countA * countB floats, element {@code b * countA + a}
     * @param extentA range of posA, in any unit, at least 1
     * @param extentB likewise of posB
     * @param countA elements along a, N
     * @param countB likewise along b
     * @param posA where, -extentA / 2 to extentA / 2; beyond it, the part of the cone inside the field is added
     * @param posB likewise
     * @param amplitude a third of the cone's height; negative for a hollow
     */
    public native void ripple(float[] field, int extentA, int extentB, int countA, int countB, float posA, float posB,
            float amplitude);

    /**
     * Takes one touch of one finger; with ink, the next frame drops it there. The distance between two touches decides
     * what kind of stroke is drawn: call it once for each frame while the finger moves, however often that is reported.
     *
     * @param x pixels from the left edge of the view; outside of it is allowed
     * @param y pixels from its top edge, likewise
     * @param action as in {@code MotionEvent}: 0 down, 1 up, 2 move, 3 cancel; others only move the touch point
     * @param pressure as the screen reports it, around 1; 0 and less for a slow stroke without ink
     */
    public native void onTouch(int x, int y, int action, float pressure);

    /**
     * Draws one frame over the whole view, without clearing it: without ink into the current framebuffer, with ink into
     * framebuffer 0. With ink this is also one step of the ink, of which 60 are due a second, and with counts
     * of 0 nothing else.
     *
     * @param positions from {@link #initWaters}
     * @param heightAttribs for each vertex its height and those of the vertices to its right and above it, 3 floats
     * @param indices from {@link #initWaters}
     * @param positionFloats floats of {@code positions}, 3 * N * N
     * @param heightFloats likewise
     * @param indexCount shorts of {@code indices}, 6 * (N - 1) * (N - 1)
     * @param mvp from model units to clip space, 16 floats, column by column; it must not turn or tilt the mesh
     * @param meshSizeWidth extent along x in model units that the picture covers, at least 1
     * @param meshSizeHeight likewise along y
     * @param numDetailsWidth vertices along x, N
     * @param numDetailsHeight too
     * @param refractiveIndex of the water, 1 for no bending
     * @param alphaMix share of the light's picture on a wave, 0 to 1
     * @param alphaScale1 factor on that share, 0 to 1
     * @param alphaScale2 factor on the other share; not read by the shaders of today
     * @param inkRed of the ink's colour, 0 to 0.75; more brightens instead of darkening
     * @param inkGreen likewise
     * @param inkBlue likewise
     * @param fresnelRatio extra light on slopes that face the light
     * @param specularRatio strength of the highlights; the picture takes up to 5.5 of it, with ink up to 4.5
     * @param exponent sharpness of the highlights
     * @param landscape whether to show the background for landscape
     */
    public native void onDrawFrame(float[] positions, float[] heightAttribs, short[] indices, int positionFloats,
            int heightFloats, int indexCount, float[] mvp, int meshSizeWidth, int meshSizeHeight, int numDetailsWidth,
            int numDetailsHeight, float refractiveIndex, float alphaMix, float alphaScale1, float alphaScale2,
            float inkRed, float inkGreen, float inkBlue, float fresnelRatio, float specularRatio, float exponent,
            boolean landscape);

    /**
     * Whether ink is shown, not whether any is left: count frames since the last touch for that.
     *
     * @return 1 after a touch and, with ink, after the set-up; 0 after a cancelled touch or {@link #clearInkValue}
     */
    public native int getClearInkValue();

    /** Lets all ink vanish with the next frame, and ends the gesture. */
    public native void clearInkValue();
}
