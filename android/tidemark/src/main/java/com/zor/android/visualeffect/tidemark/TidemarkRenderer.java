package com.zor.android.visualeffect.tidemark;

import android.opengl.GLES20;
import android.opengl.GLSurfaceView;
import android.os.SystemClock;

import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.opengles.GL10;

/**
 * Draws a {@link LiveWater} into a {@code GLSurfaceView} of {@code RENDERMODE_WHEN_DIRTY}, and asks for frames only
 * while something moves. Whoever changes the water does so on the GL thread, through {@code queueEvent}, and asks for a
 * frame; {@link TidemarkView} does.
 */
public final class TidemarkRenderer implements GLSurfaceView.Renderer {
    private final LiveWater water;
    private final Runnable requestRender;

    /** {@code requestRender} asks for one frame, as the method of that name of {@code GLSurfaceView} does. */
    public TidemarkRenderer(LiveWater water, Runnable requestRender) {
        this.water = water;
        this.requestRender = requestRender;
    }

    /** Also after the context was lost, in a pause for example. */
    @Override
    public void onSurfaceCreated(GL10 gl, EGLConfig config) {
        water.renewContext();
    }

    @Override
    public void onSurfaceChanged(GL10 gl, int width, int height) {
        water.resize(width, height);
    }

    @Override
    public void onDrawFrame(GL10 gl) {
        // The surface shows its buffer after every call, so every call has to fill it.
        water.redraw();
        double start = seconds();
        LiveWater.Frame frame;
        while ((frame = water.frame(start)) == LiveWater.Frame.WAITING) {
            SystemClock.sleep(1);
            start = seconds();
        }
        if (frame == LiveWater.Frame.DRAWN) water.noteWork(seconds() - start);
        if (frame == LiveWater.Frame.RESTING) GLES20.glClear(GLES20.GL_COLOR_BUFFER_BIT);  // no pictures yet
        if (!water.isResting()) requestRender.run();
    }

    private static double seconds() {
        return SystemClock.elapsedRealtimeNanos() * 1.0e-9;
    }
}
