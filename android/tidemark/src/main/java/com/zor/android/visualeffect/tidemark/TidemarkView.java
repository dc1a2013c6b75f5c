package com.zor.android.visualeffect.tidemark;

import android.app.Activity;
import android.app.ActivityManager;
import android.content.Context;
import android.content.res.Resources;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.opengl.GLSurfaceView;
import android.util.AttributeSet;
import android.view.MotionEvent;
import android.view.SurfaceHolder;
import android.view.ViewConfiguration;

import org.jetbrains.annotations.NotNull;
import org.jetbrains.annotations.Nullable;

/**
 * Rippling water over a picture, which answers to touches. Put it into a layout, give it pictures, and let it
 * {@link #followLifecycle follow the activity}. Use it on the main thread. What is set while the view is not shown takes
 * effect when it is.
 *
 * <p>A layout may say {@code app:portrait}, {@code app:landscape} and {@code app:light} (drawables that are bitmaps),
 * {@code app:look} (a raw resource that {@link Look#load} reads), {@code app:ink}, {@code app:rain} and
 * {@code app:quality}.
 *
 * <p>Of several views that are seen the newest one draws, since the library serves a single effect. An older one
 * rests, and goes on when the newer one is stopped, hidden or taken out of its window.
 */
public class TidemarkView extends GLSurfaceView {
    private static final int OPENGL_ES_2 = 0x20000;

    final TidemarkRenderer renderer =
            new TidemarkRenderer(this::requestFrame, (width, height) -> getHolder().setFixedSize(width, height));
    private final FirstFinger finger = new FirstFinger(this::touch);
    private final Resources resources;
    private boolean isLaidOut;
    private float width;  // of the view, pixels
    private float height;
    private boolean canDraw;  // not in a layout editor
    private boolean isStopped;
    private boolean hasSurface;
    private boolean mayBeClick;
    private float downX;
    private float downY;

    /**
     * For code.
     *
     * @param context the activity, or another one
     */
    public TidemarkView(@NotNull Context context) {
        this(context, null);
    }

    /**
     * For layouts.
     *
     * @param context the activity, or another one
     * @param attributes of the layout; null for none
     */
    public TidemarkView(@NotNull Context context, @Nullable AttributeSet attributes) {
        super(context, attributes);
        resources = context.getResources();
        canDraw = !isInEditMode() && hasOpenGl(context);
        if (canDraw) {
            prepareSurface();
        } else {
            getHolder().removeCallback(this);  // there is no thread to tell of a surface
        }
        if (attributes == null) return;
        TypedArray given = context.obtainStyledAttributes(attributes, R.styleable.TidemarkView);
        try {
            ViewAttributes.apply(given, this);
        } finally {
            given.recycle();
        }
    }

    private void prepareSurface() {
        setEGLContextClientVersion(2);
        setEGLConfigChooser(8, 8, 8, 0, 0, 0);
        setEGLContextFactory(new ContextFactory(this::requestRender));
        setPreserveEGLContextOnPause(true);
        setRenderer(renderer);
        setRenderMode(RENDERMODE_WHEN_DIRTY);
    }

    /**
     * Hears on the main thread when the water is calm and what fails.
     *
     * @param listener null for nobody
     */
    public void setListener(@Nullable TidemarkListener listener) {
        renderer.setListener(listener);
        if (canDraw || isInEditMode()) return;
        renderer.report(TidemarkListener.Failure.NO_OPENGL, "this device has no OpenGL ES 2.0");
    }

    /**
     * Shows other pictures. The backgrounds may have any size: they are cropped to the view and scaled down to it. No side
     * of the light may be longer than the device's largest texture, 2048 pixels being safe everywhere. Keep the bitmaps
     * unchanged while the view uses them.
     *
     * @param portrait what the water lies over in an upright view
     * @param landscape and in a wide one
     * @param light on the waves, of any proportions
     * @throws IllegalArgumentException for a bitmap that is null or recycled
     */
    public void setPictures(@NotNull Bitmap portrait, @NotNull Bitmap landscape, @NotNull Bitmap light) {
        renderer.setPictures(new Pictures(portrait, landscape, light));
    }

    /**
     * Changes how the water looks and moves; the water and the ink stay.
     *
     * @param look is copied
     * @throws IllegalArgumentException naming a value that is beyond its limits; nothing changes
     */
    public void setLook(@NotNull Look look) {
        renderer.setLook(look);
    }

    /**
     * Switches the ink; it is off at first.
     *
     * @param withInk whether touches drop ink
     */
    public void setInk(boolean withInk) {
        renderer.setInk(withInk);
    }

    /** Lets all ink vanish. */
    public void clearInk() {
        renderer.clearInk();
    }

    /**
     * Switches the rain; it is off at first.
     *
     * @param falling whether it rains
     */
    public void setRain(boolean falling) {
        renderer.setRain(falling);
    }

    /**
     * Chooses how many pixels are drawn; {@link Quality#AUTO} at first.
     *
     * @param quality at the cost of time and of battery
     */
    public void setQuality(@NotNull Quality quality) {
        renderer.setQuality(quality);
    }

    /**
     * A splash without a finger; it drops no ink. Nothing while the view is not shown.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param strength 1 for that of a finger that comes down
     */
    public void ripple(float x, float y, float strength) {
        renderer.ripple(x / width, y / height, strength);
    }

    /**
     * Calls {@link #onStart} and {@link #onStop} with the activity's own from now on, until it is destroyed. Call it in
     * {@code onCreate}.
     *
     * @param activity in whose window the view is
     */
    public void followLifecycle(@NotNull Activity activity) {
        activity.getApplication().registerActivityLifecycleCallbacks(new ActivityFollower(activity, this));
    }

    /** With the activity's own {@code onStart}, or the fragment's; {@link #followLifecycle} spares you the call. */
    public void onStart() {
        isStopped = false;
        showOrHide();
        if (canDraw) super.onResume();
    }

    /**
     * With the activity's own {@code onStop}. Between the two the view draws nothing; its water and its ink go on where
     * they were, unless the device takes the context away.
     */
    public void onStop() {
        isStopped = true;
        showOrHide();
        if (canDraw) super.onPause();
    }

    /**
     * Does nothing. An activity is paused while it is still seen, below a dialog or beside another app: use
     * {@link #onStop}.
     */
    @Override
    public final void onPause() {}

    /** Does nothing: use {@link #onStart}. */
    @Override
    public final void onResume() {}

    @Override
    public boolean onTouchEvent(@NotNull MotionEvent event) {
        finger.follow(event);
        switch (event.getActionMasked()) {
            case MotionEvent.ACTION_DOWN:
                // A list around the view would take the finger's way for scrolling.
                if (getParent() != null) getParent().requestDisallowInterceptTouchEvent(true);
                mayBeClick = true;
                downX = event.getX(0);
                downY = event.getY(0);
                break;
            case MotionEvent.ACTION_UP:
                if (mayBeClick && isNearDown(event)) performClick();
                break;
            default:
                mayBeClick &= event.getActionMasked() == MotionEvent.ACTION_MOVE && isNearDown(event);
        }
        return true;
    }

    /** For a tap, and for services that tap without a finger. */
    @Override
    public boolean performClick() {
        return super.performClick();
    }

    @Override
    protected void onSizeChanged(int width, int height, int oldWidth, int oldHeight) {
        super.onSizeChanged(width, height, oldWidth, oldHeight);
        isLaidOut = true;
        this.width = width;
        this.height = height;
        double density = resources.getDisplayMetrics().density;
        renderer.setView(width / density, height / density, density);
    }

    @Override
    public void surfaceChanged(SurfaceHolder holder, int format, int width, int height) {
        if (!isLaidOut) {  // in no window, as in a wallpaper
            this.width = width;
            this.height = height;
        }
        super.surfaceChanged(holder, format, width, height);
    }

    @Override
    public void surfaceCreated(SurfaceHolder holder) {
        hasSurface = true;
        showOrHide();
        super.surfaceCreated(holder);
    }

    @Override
    public void surfaceDestroyed(SurfaceHolder holder) {
        hasSurface = false;
        showOrHide();
        super.surfaceDestroyed(holder);
    }

    @Override
    protected void onDetachedFromWindow() {
        hasSurface = false;
        showOrHide();
        super.onDetachedFromWindow();
    }

    private void touch(int action, float x, float y, boolean isStylus, float pressure, long time) {
        renderer.touch(action, x / width, y / height, isStylus, pressure, time);
    }

    private void showOrHide() {
        if (hasSurface && !isStopped) {
            renderer.show();
        } else {
            finger.lift();
            renderer.hide();
        }
    }

    private boolean isNearDown(MotionEvent event) {
        int slop = ViewConfiguration.get(getContext()).getScaledTouchSlop();
        return Math.abs(event.getX(0) - downX) <= slop && Math.abs(event.getY(0) - downY) <= slop;
    }

    // Without it the GL thread would throw.
    private static boolean hasOpenGl(Context context) {
        ActivityManager device = (ActivityManager) context.getSystemService(Context.ACTIVITY_SERVICE);
        return device == null || device.getDeviceConfigurationInfo().reqGlEsVersion >= OPENGL_ES_2;
    }

    private void requestFrame() {
        if (canDraw) requestRender();
    }
}
