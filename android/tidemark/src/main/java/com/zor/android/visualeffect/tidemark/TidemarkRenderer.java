package com.zor.android.visualeffect.tidemark;

import android.opengl.GLES20;
import android.opengl.GLSurfaceView;
import android.os.SystemClock;

import javax.microedition.khronos.egl.EGLConfig;
import javax.microedition.khronos.opengles.GL10;

/**
 * Draws the water into a {@code GLSurfaceView} of {@code RENDERMODE_WHEN_DIRTY}, and asks for frames only while
 * something moves. Call every method on the GL thread, through {@code queueEvent}; {@link TidemarkView} does so.
 */
public final class TidemarkRenderer implements GLSurfaceView.Renderer {
    private final WaterHost host;
    private final FrameClock clock;
    private final Runnable requestRender;
    private Pictures pictures;
    private boolean withInk;
    private boolean setUpDue = true;  // at the next frame, where the context is current

    /** {@code requestRender} asks for one frame, as the method of that name of {@code GLSurfaceView} does. */
    public TidemarkRenderer(Look look, Runnable requestRender) {
        host = new WaterHost(new JniTidemarkRender(), look, 1, 1, (int) System.nanoTime());
        clock = new FrameClock(look.stepsPerSecond);
        this.requestRender = requestRender;
    }

    /** Nothing but black is drawn before the first call. The bitmaps must stay alive. */
    public void setPictures(Pictures pictures) {
        this.pictures = pictures;
        setUpDue = true;
        requestRender.run();
    }

    /** Whether touches drop ink. Either way a stroke that is being drawn ends. */
    public void setInk(boolean withInk) {
        this.withInk = withInk;
        host.clearInk();
        setUpDue = true;
        requestRender.run();
    }

    public void clearInk() {
        host.clearInk();
        requestRender.run();
    }

    public void setRain(boolean falling) {
        host.rain(falling);
        requestRender.run();
    }

    /** One touch event, as {@link WaterHost#touch} takes it. */
    public void touch(int action, int x, int y, float pressure) {
        host.touch(action, x, y, pressure);
        requestRender.run();
    }

    /** Also after the context was lost, in a pause for example. */
    @Override
    public void onSurfaceCreated(GL10 gl, EGLConfig config) {
        setUpDue = true;
    }

    @Override
    public void onSurfaceChanged(GL10 gl, int width, int height) {
        host.resize(width, height);
        clock.rest();
        setUpDue = true;
    }

    @Override
    public void onDrawFrame(GL10 gl) {
        if (pictures == null) {
            GLES20.glClear(GLES20.GL_COLOR_BUFFER_BIT);
            return;
        }
        SystemClock.sleep(clock.nanosToWait(System.nanoTime()) / 1000000);
        drawFrame(System.nanoTime());
    }

    void drawFrame(long now) {
        if (setUpDue) {
            host.handOver(pictures);
            host.setUp(withInk);
            setUpDue = false;
        }
        host.advance(clock.secondsUntil(now));
        host.draw();
        if (host.isResting()) {
            clock.rest();
        } else {
            requestRender.run();
        }
    }
}
