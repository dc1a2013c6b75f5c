package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.graphics.Bitmap;
import android.opengl.GLSurfaceView;
import android.util.AttributeSet;
import android.view.MotionEvent;

/**
 * Rippling water over a picture, which answers to touches. Put it into a layout, give it pictures, and call
 * {@link #onPause} and {@link #onResume} with the activity's own. Use it on the main thread, and one at a time: the
 * library serves a single effect.
 */
public class TidemarkView extends GLSurfaceView {
    private final LiveWater water = new LiveWater(new JniTidemarkRender(), new Look(), (int) System.nanoTime());
    final TidemarkRenderer renderer = new TidemarkRenderer(water, this::requestRender);
    private final FirstFinger finger = new FirstFinger(this::forwardTouch);

    public TidemarkView(Context context) {
        this(context, null);
    }

    public TidemarkView(Context context, AttributeSet attributes) {
        super(context, attributes);
        setEGLContextClientVersion(2);
        setEGLConfigChooser(8, 8, 8, 0, 0, 0);
        setRenderer(renderer);
        setRenderMode(RENDERMODE_WHEN_DIRTY);
    }

    /**
     * What the water lies over in portrait and in landscape, and the light on the waves. The backgrounds are cropped to
     * the view; no side may be longer than the device's largest texture, 2048 pixels being safe everywhere. Keep the
     * bitmaps unchanged while the view uses them.
     */
    public void setPictures(Bitmap portrait, Bitmap landscape, Bitmap light) {
        Pictures pictures = new Pictures(portrait, landscape, light);
        change(() -> water.setPictures(pictures));
    }

    /** Whether touches drop ink; they do not at first. */
    public void setInk(boolean withInk) {
        change(() -> water.setInk(withInk));
    }

    public void clearInk() {
        change(water::clearInk);
    }

    /** Whether it rains; it does not at first. */
    public void setRain(boolean falling) {
        change(() -> water.setRain(falling));
    }

    @Override
    public boolean onTouchEvent(MotionEvent event) {
        finger.follow(event);
        return true;
    }

    @Override
    public void onPause() {
        finger.cancel();
        super.onPause();
    }

    // The event itself is recycled before the GL thread could read it.
    private void forwardTouch(int action, int x, int y, float pressure) {
        change(() -> water.touch(action, x, y, pressure));
    }

    private void change(Runnable call) {
        queueEvent(() -> {
            call.run();
            requestRender();
        });
    }
}
