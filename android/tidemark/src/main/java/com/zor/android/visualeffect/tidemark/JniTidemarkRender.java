package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

/**
 * The interface of the native library, which {@code jni/natives.h} documents in full. Most apps use
 * {@link TidemarkView}, which makes these calls in the right order. All objects of this class share one effect.
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
 * <li>for every frame {@link #move} and {@link #ripple} as the animation needs, {@link #onTouch} for a touch, and
 * {@link #onDrawFrame} once
 * </ol>
 * For another size of the view or another mode, repeat the second step; for a new context, after the old one was lost,
 * the second and the third.
 *
 * <p><b>The mesh.</b> N x N vertices in the plane z = 0, N from 2 to 256, stored column by column from the left, each
 * column from the top. Model x runs to the right and y upwards, from minus to plus half the mesh's size; the eye is 30
 * units away. The arrays belong to the caller. The library does not check lengths and counts: a short array crashes.
 *
 * <p>{@code docs/look.md} gives suitable ranges for the numbers of {@link #move}, {@link #ripple} and
 * {@link #onDrawFrame}.
 */
public final class JniTidemarkRender {
    static {
        System.loadLibrary("TidemarkEffect");
    }

    /**
     * Copies the background for portrait; the bitmap may be recycled afterwards. If it cannot be copied, the library
     * logs that and keeps the picture before.
     *
     * @param bitmap of the configuration ARGB_8888, without padding between its rows, and with sides from 1 pixel to
     *     the driver's largest texture; it is stretched over the view, so crop it to the view's proportions before
     */
    public native void transferPortraitBGBitmap(Bitmap bitmap);

    /**
     * Copies the background for landscape, as {@link #transferPortraitBGBitmap} does.
     *
     * @param bitmap as for portrait
     */
    public native void transferLandscapeBGBitmap(Bitmap bitmap);

    /**
     * Copies the picture of the light on the waves, as {@link #transferPortraitBGBitmap} does.
     *
     * @param bitmap as for portrait, with any proportions
     */
    public native void transferWaterBitmap(Bitmap bitmap);

    /**
     * Sets the size and the mode; {@link #onInitGPU} must follow.
     *
     * @param width of the view in pixels, 1 to the driver's largest viewport; with ink at least 12
     * @param height of the view in pixels, with the same limits
     * @param withInk whether touches drop ink into the water; without ink it costs nothing
     */
    public native void onInitSetting(int width, int height, boolean withInk);

    /** Creates programs, render targets and buffers for the size and the mode of {@link #onInitSetting}. */
    public native void onInitGPU();

    /** Uploads the background for portrait that was copied last. */
    public native void onLoadPortraitBGTextures();

    /** Uploads the background for landscape that was copied last. */
    public native void onLoadLandscapeBGTextures();

    /** Uploads the picture of the light that was copied last. */
    public native void onLoadWaterTextures();

    /**
     * Fills the arrays of a flat mesh.
     *
     * @param positions receives x, y, z of every vertex in model units; 3 * vertexCount floats
     * @param indices receives two triangles a cell, as unsigned vertex numbers; 6 * (N - 1) * (N - 1) shorts
     * @param vertexCount vertices to fill, N * N
     * @param meshSizeWidth extent along x in model units, at least 1
     * @param meshSizeHeight extent along y in model units, at least 1
     * @param numDetailsWidth vertices along x, N
     * @param numDetailsHeight vertices along y, N
     */
    public native void initWaters(float[] positions, short[] indices, int vertexCount, int meshSizeWidth,
            int meshSizeHeight, int numDetailsWidth, int numDetailsHeight);

    /**
     * Computes one wave step in a rectangle of two fields of N * N floats, in which {@code y * stride + x} is the index
     * of (x, y). The elements next to the rectangle are read and not changed. On the mesh, x counts down a column, and y
     * counts the columns from the left.
     *
     * @param velocity speeds in model units a step
     * @param height heights in model units; kept within -100 to 100
     * @param xStart first x, at least 1
     * @param yStart first y, at least 1
     * @param xEnd one past the last x, at most N - 1
     * @param yEnd one past the last y, at most N - 1
     * @param stride elements from one y to the next, N
     * @param rowCount ignored; N
     * @param checkCalm whether to find out if the water is calm
     * @param damping factor on every speed, 0 to 1; 0.94 exactly also smooths the surface more
     * @param waveSpeed factor on the curvature, 0 to 0.5, above which waves blow up
     * @return true when every speed lies within -0.009 to 0.009 after the step, and always without {@code checkCalm}
     */
    public native boolean move(float[] velocity, float[] height, int xStart, int yStart, int xEnd, int yEnd, int stride,
            int rowCount, boolean checkCalm, float damping, float waveSpeed);

    /**
     * Adds a cone of three cells' radius to a field. The two outermost elements on the near sides and the outermost one
     * on the far sides do not change. On the mesh, a counts down a column, and b counts the columns from the left.
     *
     * @param field heights (or speeds) in model units, countA * countB floats, element {@code b * countA + a}
     * @param extentA range of posA, in any unit, at least 1
     * @param extentB range of posB, in the same unit, at least 1
     * @param countA elements along a, N
     * @param countB elements along b, N
     * @param posA centre of the cone, -extentA / 2 to extentA / 2; outside, only the part of it in the field is added
     * @param posB centre of the cone, -extentB / 2 to extentB / 2
     * @param amplitude a third of the cone's height; negative for a hollow
     */
    public native void ripple(float[] field, int extentA, int extentB, int countA, int countB, float posA, float posB,
            float amplitude);

    /**
     * Stores the touch of one finger; with ink, the next frame drops ink there. The kind of the stroke follows from
     * the distance between two touches, so call this once for each frame in which the finger has moved.
     *
     * @param x pixels from the left edge of the view; may be outside it
     * @param y pixels from the top edge of the view; may be outside it
     * @param action as in {@code MotionEvent}: 0 down, 1 up, 2 move, 3 cancel; others only move the touch point
     * @param pressure as the screen reports it, around 1; a slow stroke with 0 or less drops no ink
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
     * @param heightFloats floats of {@code heightAttribs}, 3 * N * N
     * @param indexCount shorts of {@code indices}, 6 * (N - 1) * (N - 1)
     * @param mvp from model units to clip space, 16 floats, column by column; it must not turn or tilt the mesh
     * @param meshSizeWidth extent along x in model units that the picture covers, at least 1
     * @param meshSizeHeight extent along y in model units that the picture covers, at least 1
     * @param numDetailsWidth vertices along x, N
     * @param numDetailsHeight vertices along y, N
     * @param refractiveIndex of the water, 1 for no bending
     * @param alphaMix share of the light's picture on a wave, 0 to 1
     * @param alphaScale1 factor on that share, 0 to 1
     * @param alphaScale2 factor on the other share, which the shaders do not read
     * @param inkRed red of the ink, 0 to 0.75; more would make the picture brighter
     * @param inkGreen green of the ink, 0 to 0.75
     * @param inkBlue blue of the ink, 0 to 0.75
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
     * Returns whether ink is drawn. To find out whether any is left, count the frames since the last touch.
     *
     * @return 1 after a touch and, with ink, after the set-up; 0 after a cancelled touch or {@link #clearInkValue}
     */
    public native int getClearInkValue();

    /** Removes all ink with the next frame, and ends the gesture. */
    public native void clearInkValue();
}
