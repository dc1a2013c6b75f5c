package com.example.water;

import android.graphics.Bitmap;
import android.opengl.GLSurfaceView;

import com.zor.android.visualeffect.tidemark.JniTidemarkRender;

import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.opengles.GL10;

/**
 * The smallest host: water over a picture, with ink, drawn all the time. It is the renderer of a {@code GLSurfaceView}
 * with {@code setEGLContextClientVersion(2)}. Call all other methods on its thread, with {@code queueEvent}.
 */
public final class MinimalWater implements GLSurfaceView.Renderer {
    private static final int N = 128;  // vertices along each side of a square mesh around the view
    private static final int EXTENT = 32;  // of that side, model units
    private static final long STEP = 1000000000 / 60;  // of the waves, nanoseconds
    private static final float DAMPING = 0.985f;
    private static final float WAVE_SPEED = 0.3f;

    private final JniTidemarkRender library = new JniTidemarkRender();
    private final Bitmap portrait;
    private final Bitmap landscape;
    private final Bitmap light;
    private final float[] positions = new float[3 * N * N];
    private final short[] indices = new short[6 * (N - 1) * (N - 1)];
    private final float[] velocity = new float[N * N];
    private final float[] heights = new float[N * N];
    private final float[] heightAttribs = new float[3 * N * N];
    private final float[] mvp = new float[16];
    private int width;
    private int height;
    private float visibleWidth;  // of the mesh, model units
    private float visibleHeight;
    private long lastStep;

    /** Takes bitmaps of the configuration ARGB_8888. Crop the backgrounds to the proportions of the view. */
    public MinimalWater(Bitmap portrait, Bitmap landscape, Bitmap light) {
        this.portrait = portrait;
        this.landscape = landscape;
        this.light = light;
    }

    @Override
    public void onSurfaceCreated(GL10 gl, EGLConfig config) {
        library.transferPortraitBGBitmap(portrait);
        library.transferLandscapeBGBitmap(landscape);
        library.transferWaterBitmap(light);
    }

    /** Sets the library up, in a new context too: the platform calls this after {@link #onSurfaceCreated}. */
    @Override
    public void onSurfaceChanged(GL10 gl, int width, int height) {
        this.width = width;
        this.height = height;
        library.onInitSetting(width, height, true);
        library.onInitGPU();
        library.onLoadPortraitBGTextures();
        library.onLoadLandscapeBGTextures();
        library.onLoadWaterTextures();
        library.initWaters(positions, indices, N * N, EXTENT, EXTENT, N, N);
        visibleWidth = (float) EXTENT * width / Math.max(width, height);
        visibleHeight = (float) EXTENT * height / Math.max(width, height);
        mvp[0] = 2 / visibleWidth;
        mvp[5] = 2 / visibleHeight;
        mvp[10] = 1;
        mvp[15] = 1;
        lastStep = System.nanoTime();
    }

    /** Takes 60 wave steps a second, whatever the display's refresh rate. */
    @Override
    public void onDrawFrame(GL10 gl) {
        long now = System.nanoTime();
        if (now - lastStep > 15 * STEP) lastStep = now;  // do not catch up after a pause
        for (; now - lastStep >= STEP; lastStep += STEP) step();
        draw();
    }

    /** Takes one wave step. */
    public void step() {
        library.move(velocity, heights, 1, 1, N - 1, N - 1, N, N, false, DAMPING, WAVE_SPEED);
    }

    /** Draws the water, and moves the ink by one step. */
    public void draw() {
        for (int i = 0; i < N * N; ++i) {  // column by column from the left, each from the top
            heightAttribs[3 * i] = heights[i];
            heightAttribs[3 * i + 1] = heights[i + N < N * N ? i + N : i];
            heightAttribs[3 * i + 2] = heights[i % N > 0 ? i - 1 : i];
        }
        library.onDrawFrame(positions, heightAttribs, indices, positions.length, heightAttribs.length, indices.length,
                mvp, (int) Math.ceil(visibleWidth * 1.015f), (int) Math.ceil(visibleHeight * 1.015f), N, N,
                1.75f, 0.5f, 0.7f, 1, 0.05f, 0.15f, 0.45f, 0.8f, 4.5f, 40, width > height);
    }

    /** Takes a touch of the first finger, in pixels. Of several moves before a frame, pass the last one only. */
    public void touch(int x, int y, int action, float pressure) {
        library.onTouch(x, y, action, pressure);
        float across = (x - 0.5f * width) / width * visibleWidth;
        float down = (y - 0.5f * height) / height * visibleHeight;
        float size = pressure * (action == 0 ? 2 : action == 2 ? 0.25f : 0);  // down: 2, move: 0.25
        library.ripple(heights, EXTENT, EXTENT, N, N, down, across, size);
    }

    /** Returns whether ink is drawn, for example to enable a button that clears it. */
    public boolean showsInk() {
        return library.getClearInkValue() == 1;
    }

    public void clearInk() {
        library.clearInkValue();
    }
}
