package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.net.Uri;
import android.os.Parcelable;
import android.util.AttributeSet;
import android.view.MotionEvent;
import android.view.Surface;
import android.widget.FrameLayout;

import androidx.annotation.ColorInt;
import androidx.annotation.DrawableRes;
import androidx.annotation.FloatRange;
import androidx.annotation.MainThread;
import androidx.annotation.NonNull;
import androidx.annotation.Nullable;

import java.util.Objects;

/**
 * Rippling water over a picture, which answers to touches. Put it into a layout with {@code app:tidemarkPicture}, or
 * create it and call {@link #setPicture(int)}. Views inside it are drawn above the water.
 *
 * <p>Call all methods on the main thread. They return at once, except {@link #toBitmap}. Null for a parameter that is
 * marked as non-null throws an exception.
 *
 * <p>The view draws while it is visible and something in it moves. If several views are visible, only the newest one
 * that has a picture draws, because the native library serves a single effect. The others keep their last frame, and
 * the previous one draws again when the newest is hidden.
 *
 * <p>If the view has an {@code android:id}, it saves the ink, the rain, and pictures that are resources or have a
 * {@code Uri} with the state of the activity. It does not save the water.
 */
@MainThread
public class TidemarkView extends FrameLayout {
    private static final int FIRST_DROP_DELAY = 700;  // milliseconds after the first frame
    private static final float FIRST_DROP_X = 0.5f;  // as a share of the view
    private static final float FIRST_DROP_Y = 0.42f;
    private static final float BRIGHTEST_INK = 0.75f;  // brighter ink would light the picture up

    private final ListenerNotifier notifier = new ListenerNotifier() {
        @Override
        public void stateChanged(TidemarkRenderer.State state) {
            if (state == TidemarkRenderer.State.RESTING) touches.lift();
            super.stateChanged(state);
        }

        @Override
        void firstFrameShown() {
            if (firstDrop && !settings.isReduced) TidemarkRenderer.MAIN.postDelayed(
                    () -> drop(FIRST_DROP_X * width, FIRST_DROP_Y * height), FIRST_DROP_DELAY);
        }

        @Override
        public void surfaceSizeWanted(int width, int height) {
            if (surface != null) surface.setSize(width, height);
        }
    };
    private final WaterSettings settings = new WaterSettings();
    private final TidemarkRenderer renderer = new TidemarkRenderer(notifier);
    private final TouchInput touches;
    private final PictureRequests pictures;
    private final Context context;
    private final WaterSurface surface;  // null in a layout editor
    private boolean firstDrop;
    private Runnable earlyDrop;  // asked for before the first surface
    private int width = 1;  // to which touches and drops refer, pixels
    private int height = 1;

    /**
     * Creates a view with a surface of its own behind the window's.
     *
     * @param context the activity, or another one with resources
     */
    public TidemarkView(@NonNull Context context) {
        this(context, false);
    }

    /**
     * Creates a view.
     *
     * @param context the activity, or another one with resources
     * @param onTexture whether the water is drawn on a texture of the window, so that it can be faded, clipped and
     *     animated as other views can, at the cost of a copy of every frame
     */
    public TidemarkView(@NonNull Context context, boolean onTexture) {
        this(context, null, onTexture);
    }

    /**
     * Creates a view from a layout.
     *
     * @param context the activity, or another one with resources
     * @param attributes the attributes in the layout; null for none
     */
    public TidemarkView(@NonNull Context context, @Nullable AttributeSet attributes) {
        this(context, attributes, false);
    }

    private TidemarkView(Context context, AttributeSet attributes, boolean onTexture) {
        super(context, attributes);
        this.context = context;
        touches = new TouchInput(this, this::touch);
        pictures = new PictureRequests(context, notifier, decoded -> {
            settings.pictures = decoded;
            update();
        });
        TypedArray values = attributes == null
                ? null : context.obtainStyledAttributes(attributes, R.styleable.TidemarkView);
        boolean isTexture =
                onTexture || values != null && values.getBoolean(R.styleable.TidemarkView_tidemarkTexture, false);
        surface = isInEditMode() ? null : new WaterSurface(context, isTexture, this::setWindow);
        if (surface != null) addView(surface.view(), 0);
        if (values == null) return;
        try {
            ViewAttributes.apply(values, this);
        } finally {
            values.recycle();
        }
    }

    /**
     * Sets the object that is called when the state of the water changes or something fails.
     *
     * @param listener replaces the previous one; null for none
     */
    public void setListener(@Nullable TidemarkListener listener) {
        notifier.setListener(listener);
    }

    /**
     * Shows a picture of any size: it is cropped to the view and scaled down to it.
     *
     * @param picture is not copied: do not draw into it while the view shows it. If you recycle it, the view keeps what
     *     it shows, and calls {@link TidemarkListener#onFailure} when it needs the picture in another size or colour
     * @throws IllegalArgumentException for a bitmap that is recycled
     */
    public void setPicture(@NonNull Bitmap picture) {
        setPictures(picture, picture, null);
    }

    /**
     * Shows a picture, which is decoded on another thread. Until then the view keeps the picture before; if decoding
     * fails, it does so for good and calls {@link TidemarkListener#onFailure}. Of several calls, the last one counts.
     *
     * @param picture the identifier of a drawable that is a bitmap
     */
    public void setPicture(@DrawableRes int picture) {
        setPictures(picture, picture, 0);
    }

    /**
     * Shows a picture as {@link #setPicture(int)} does, with its EXIF orientation applied.
     *
     * @param picture the address of a document or a file that the app may read
     */
    public void setPicture(@NonNull Uri picture) {
        pictures.request(picture, picture, null);
    }

    /**
     * Shows one picture while the view is higher than wide, and another while it is wider than high.
     *
     * @param portrait null for the same as {@code landscape}
     * @param landscape null for the same as {@code portrait}
     * @param light the picture that the waves reflect, best a square one; null for the module's own
     * @throws IllegalArgumentException for a bitmap that is recycled, or if both backgrounds are null
     */
    public void setPictures(@Nullable Bitmap portrait, @Nullable Bitmap landscape, @Nullable Bitmap light) {
        for (Bitmap bitmap : new Bitmap[] {portrait, landscape, light}) {
            if (bitmap != null && bitmap.isRecycled()) throw new IllegalArgumentException("a picture is recycled");
        }
        pictures.request(portrait, landscape, light);
    }

    /**
     * Shows pictures as {@link #setPictures(Bitmap, Bitmap, Bitmap)} does, decoded as by {@link #setPicture(int)}.
     *
     * @param portrait 0 for the same as {@code landscape}
     * @param landscape 0 for the same as {@code portrait}
     * @param light 0 for the module's own
     * @throws IllegalArgumentException if both backgrounds are 0
     */
    public void setPictures(@DrawableRes int portrait, @DrawableRes int landscape, @DrawableRes int light) {
        pictures.request(portrait == 0 ? null : portrait, landscape == 0 ? null : landscape, light == 0 ? null : light);
    }

    /**
     * Sets the look, the ink and the rain. The picture does not change.
     *
     * @param preset a look with a name
     */
    public void setPreset(@NonNull Preset preset) {
        setLook(preset.look());
        setInk(preset.ink);
        setRain(preset.rain);
    }

    /**
     * Changes how the water looks and moves. Waves and ink that are there remain.
     *
     * @param look is copied
     * @throws IllegalArgumentException if a value is outside its limits; the message names it, and nothing changes
     */
    public void setLook(@NonNull Look look) {
        Look copy = look.clone();
        copy.forEach(Look::checked);
        settings.look = copy;
        update();
    }

    /** {@return a copy of the look that was set last} */
    @NonNull
    public Look getLook() {
        return settings.look.clone();
    }

    /**
     * Switches the ink on or off; it is off at first. Each change removes all ink.
     *
     * @param withInk whether touches drop ink
     */
    public void setInk(boolean withInk) {
        settings.withInk = withInk;
        update();
    }

    /** {@return whether touches drop ink} */
    public boolean getInk() {
        return settings.withInk;
    }

    /**
     * Changes the colour of the ink in the look. Ink that is there changes too.
     *
     * @param color its alpha is ignored, and a channel above three quarters of full brightness counts as three quarters
     */
    public void setInkColor(@ColorInt int color) {
        Look look = getLook();
        look.inkRed = Math.min((color >> 16 & 255) / 255f, BRIGHTEST_INK);
        look.inkGreen = Math.min((color >> 8 & 255) / 255f, BRIGHTEST_INK);
        look.inkBlue = Math.min((color & 255) / 255f, BRIGHTEST_INK);
        setLook(look);
    }

    /** {@return the colour of the ink in the look, opaque} */
    @ColorInt
    public int getInkColor() {
        Look look = settings.look;
        int red = Math.round(255 * look.inkRed);
        int green = Math.round(255 * look.inkGreen);
        return 0xff000000 | red << 16 | green << 8 | Math.round(255 * look.inkBlue);
    }

    /** Removes all ink. */
    public void clearInk() {
        renderer.clearInk();
    }

    /**
     * Sets the amount of rain; there is none at first. Any amount but 0 is stored in the look.
     *
     * @param dropsPerSecond 0 for no rain
     * @throws IllegalArgumentException outside the limits of {@link Look#rainDropsPerSecond}
     */
    public void setRain(@FloatRange(from = 0, to = 1000) float dropsPerSecond) {
        if (dropsPerSecond != 0) {
            Look look = getLook();
            look.rainDropsPerSecond = dropsPerSecond;
            setLook(look);
        }
        settings.rains = dropsPerSecond != 0;
        update();
    }

    /**
     * Switches the rain on or off.
     *
     * @param falling whether {@link Look#rainDropsPerSecond} drops fall a second
     */
    public void setRain(boolean falling) {
        setRain(falling ? settings.look.rainDropsPerSecond : 0);
    }

    /** {@return the amount of rain in drops a second; 0 for none} */
    public float getRain() {
        return settings.rains ? settings.look.rainDropsPerSecond : 0;
    }

    /**
     * Keeps the breeze of the look blowing, so that the view never stops drawing. Otherwise the breeze ends some
     * seconds after a touch. {@link Motion#REDUCED} has no breeze.
     *
     * @param always false at first
     */
    public void setBreezeAlways(boolean always) {
        settings.breezeAlways = always;
        update();
    }

    /** {@return whether the breeze blows always} */
    public boolean getBreezeAlways() {
        return settings.breezeAlways;
    }

    /**
     * Sets how many pixels are drawn. After {@link #drawOn}, the view draws as many as the surface has instead.
     *
     * @param quality {@link Quality#AUTO} at first
     */
    public void setQuality(@NonNull Quality quality) {
        settings.quality = Objects.requireNonNull(quality);
        update();
    }

    /** {@return the quality that was set last} */
    @NonNull
    public Quality getQuality() {
        return settings.quality;
    }

    /**
     * Sets the effect of touches. A view that is disabled, is paused or has no picture ignores them.
     *
     * @param interaction {@link Interaction#PRESS} at first
     */
    public void setInteraction(@NonNull Interaction interaction) {
        touches.interaction = Objects.requireNonNull(interaction);
    }

    /** {@return the effect of touches} */
    @NonNull
    public Interaction getInteraction() {
        return touches.interaction;
    }

    /**
     * Sets whether the rain, the breeze and the first drop move the water.
     *
     * @param motion {@link Motion#AUTO} at first
     */
    public void setMotion(@NonNull Motion motion) {
        settings.motion = Objects.requireNonNull(motion);
        update();
    }

    /** {@return the motion that was set last} */
    @NonNull
    public Motion getMotion() {
        return settings.motion;
    }

    /**
     * Makes one drop fall soon after the first frame, to show that the picture is under water.
     *
     * @param falling false at first; has no effect after the first frame
     */
    public void setFirstDrop(boolean falling) {
        firstDrop = falling;
    }

    /** {@return whether one drop falls soon after the first frame} */
    public boolean getFirstDrop() {
        return firstDrop;
    }

    /**
     * Makes a drop of strength 1 without ink fall, see {@link #drop(float, float, float, boolean)}.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from the top edge of the view
     */
    public void drop(float x, float y) {
        drop(x, y, 1, false);
    }

    /**
     * Makes a drop fall. Before the first frame it waits for that frame; before the view has a surface, only the last
     * drop is kept. Later, a view that does not draw ignores the call. Coordinates that are not finite are ignored.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from the top edge of the view
     * @param strength 1 for that of a finger; for the ink, values are limited to 0.3 to 1.5
     * @param withInk whether the drop brings ink, if ink is on
     */
    public void drop(float x, float y, float strength, boolean withInk) {
        if (!renderer.isStarted()) earlyDrop = () -> drop(x, y, strength, withInk);
        renderer.drop(x / width, y / height, strength, withInk);
    }

    /**
     * Draws a stroke as a finger would: with ripples, and with ink if ink is on. It replaces the stroke before. A view
     * that does not draw ignores the call.
     *
     * @param points x and y of one point after the other, in pixels of the view
     * @param milliseconds the duration of the stroke, at least 1; each part between two points takes the same time
     * @throws IllegalArgumentException if the number of values is odd or 0
     */
    public void stroke(@NonNull float[] points, int milliseconds) {
        if (points.length == 0 || points.length % 2 != 0) throw new IllegalArgumentException("points are pairs");
        float[] shares = points.clone();
        for (int i = 0; i < shares.length; ++i) shares[i] /= i % 2 == 0 ? width : height;
        renderer.stroke(shares, Math.max(milliseconds, 1) * TidemarkRenderer.MILLISECOND);
    }

    /** Stops the water, the ink and touches until {@link #play}. */
    public void pause() {
        settings.isPaused = true;
        touches.lift();
        update();
    }

    /** Continues after {@link #pause}. */
    public void play() {
        settings.isPaused = false;
        update();
    }

    /** {@return whether {@link #pause} was called after the last {@link #play}} */
    public boolean isPaused() {
        return settings.isPaused;
    }

    /**
     * Draws a frame and waits for it, for some milliseconds.
     *
     * @return a new bitmap with as many pixels as the view draws; null if the view does not draw now
     */
    @Nullable
    public Bitmap toBitmap() {
        return renderer.toBitmap();
    }

    /**
     * Draws on a surface of the app instead of in a window, for example on that of a live wallpaper. Pass touches to
     * {@link #onTouchEvent} then. When the method returns, the view no longer uses the previous surface.
     *
     * @param surface null while it is not visible
     * @param width of the surface, pixels
     * @param height of the surface, pixels
     */
    public void drawOn(@Nullable Surface surface, int width, int height) {
        if (surface != null) setSize(width, height);
        setWindow(surface, width, height);
    }

    /** Moves the water where the first finger is. A short tap is a click, and a finger that rests a long click. */
    @Override
    public boolean onTouchEvent(@NonNull MotionEvent event) {
        boolean hasWater = settings.pictures != null && !notifier.isBroken();
        if (hasWater && isEnabled() && !settings.isPaused && touches.follow(event)) return true;
        touches.lift();
        return super.onTouchEvent(event);
    }

    // A list around the view would intercept the finger to scroll.
    void claimFinger() {
        if (getParent() != null) getParent().requestDisallowInterceptTouchEvent(true);
    }

    @Override
    protected void onSizeChanged(int width, int height, int oldWidth, int oldHeight) {
        super.onSizeChanged(width, height, oldWidth, oldHeight);
        if (width == 0 || height == 0) return;
        setSize(width, height);
        settings.setView(width, height, context.getResources().getDisplayMetrics().density);
        update();
    }

    @Override
    protected void onWindowVisibilityChanged(int visibility) {
        super.onWindowVisibilityChanged(visibility);
        if (surface != null) surface.setVisible(visibility == VISIBLE);
    }

    @Override
    protected void onDetachedFromWindow() {
        super.onDetachedFromWindow();
        setWindow(null, 0, 0);
        renderer.end();
    }

    @Override
    protected Parcelable onSaveInstanceState() {
        return SavedState.save(this, super.onSaveInstanceState(), pictures.sources());
    }

    @Override
    protected void onRestoreInstanceState(Parcelable state) {
        super.onRestoreInstanceState(SavedState.ofSuperclass(state));
        SavedState.restore(state, this, pictures);
    }

    private void setSize(int width, int height) {
        this.width = Math.max(width, 1);
        this.height = Math.max(height, 1);
    }

    private void touch(int action, float x, float y, boolean isStylus, float pressure, long time) {
        renderer.touch(action, x / width, y / height, isStylus, pressure, time * TidemarkRenderer.MILLISECOND);
    }

    private void setWindow(Object window, int width, int height) {
        if (window == null) {
            touches.lift();
        } else {
            settings.updateReduced(context);
        }
        renderer.setWindow(context, window, width, height, settings);
        if (earlyDrop == null || !renderer.isStarted()) return;
        earlyDrop.run();
        earlyDrop = null;
    }

    private void update() {
        if (!renderer.isStarted()) return;
        settings.updateReduced(context);
        renderer.update(settings);
    }
}
