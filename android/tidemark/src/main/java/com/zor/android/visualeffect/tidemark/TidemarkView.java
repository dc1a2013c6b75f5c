package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.net.Uri;
import android.os.Bundle;
import android.os.Handler;
import android.os.Looper;
import android.os.Parcelable;
import android.provider.Settings;
import android.util.AttributeSet;
import android.util.DisplayMetrics;
import android.view.GestureDetector;
import android.view.MotionEvent;
import android.view.Surface;
import android.widget.FrameLayout;

import androidx.annotation.ColorInt;
import androidx.annotation.DrawableRes;
import androidx.annotation.FloatRange;
import androidx.annotation.MainThread;
import androidx.annotation.NonNull;
import androidx.annotation.Nullable;

import java.io.IOException;
import java.util.Arrays;

/**
 * Rippling water over a picture, which answers to touches. Put it into a layout with {@code app:tidemarkPicture}, or
 * create it and call {@link #setPicture(int)}. Views inside it lie above the water. All methods are to be called on the
 * main thread; they return at once, except {@link #toBitmap}.
 *
 * <p>The view draws while it is seen and something in it moves. Of several views that are seen, the newest one that has a
 * picture draws, because the native library serves a single effect; the others keep their last picture, and the one before
 * goes on when the newest is hidden.
 *
 * <p>The view saves ink, rain and those pictures that are resources or have a {@code Uri} with the state of the activity,
 * if it has an {@code android:id}. The water itself is not saved.
 */
@MainThread
public class TidemarkView extends FrameLayout {
    private static final int FIRST_DROP_DELAY = 700;  // milliseconds after the first frame
    private static final float FIRST_DROP_X = 0.5f;  // shares of the view
    private static final float FIRST_DROP_Y = 0.42f;
    private static final float BRIGHTEST_INK = 0.75f;  // brighter ink would light the picture up

    private final Events events = new Events();
    private final Choices choices = new Choices();
    private final TidemarkRenderer renderer = new TidemarkRenderer(events);
    private final FirstFinger finger = new FirstFinger(this::touch);
    private final Context context;
    private final GestureDetector gestures;
    private final WaterSurface surface;  // null in a layout editor
    private Object[] sources = {null, null, null};  // portrait, landscape, light: a Bitmap, an Integer or a Uri
    private Object[] shown = sources;  // where they could be decoded
    private int ticket;  // of the pictures asked for last
    private Interaction interaction = Interaction.PRESS;
    private Motion motion = Motion.AUTO;
    private boolean firstDrop;
    private int width;  // that touches and drops refer to, pixels
    private int height;

    /**
     * Creates a view in code.
     *
     * @param context the activity, or another one
     */
    public TidemarkView(@NonNull Context context) {
        this(context, false);
    }

    /**
     * Creates a view in code.
     *
     * @param context the activity, or another one
     * @param onTexture whether it can be faded, clipped and animated as other views, at the cost of a copy of every frame;
     *     otherwise it has a surface of its own, behind the window's
     */
    public TidemarkView(@NonNull Context context, boolean onTexture) {
        super(context);
        this.context = context;
        gestures = new GestureDetector(context, new Taps());
        surface = addSurface(onTexture);
    }

    /**
     * Creates a view of a layout.
     *
     * @param context the activity, or another one
     * @param attributes of the layout; null for none
     */
    public TidemarkView(@NonNull Context context, @Nullable AttributeSet attributes) {
        super(context, attributes);
        this.context = context;
        gestures = new GestureDetector(context, new Taps());
        TypedArray given = context.obtainStyledAttributes(attributes, R.styleable.TidemarkView);
        try {
            surface = addSurface(given.getBoolean(R.styleable.TidemarkView_tidemarkTexture, false));
            ViewAttributes.apply(given, this);
        } finally {
            given.recycle();
        }
    }

    private WaterSurface addSurface(boolean onTexture) {
        if (isInEditMode()) return null;
        WaterSurface made = new WaterSurface(context, onTexture, this::setWindow);
        addView(made.view(), 0);
        return made;
    }

    /**
     * Hears what becomes of the water. A listener that is set late hears at once of the state that the view is in.
     *
     * @param listener null for nobody
     */
    public void setListener(@Nullable TidemarkListener listener) {
        events.setListener(listener);
    }

    /**
     * Shows a picture. It may have any size: it is cropped to the view and scaled down to it.
     *
     * @param picture is not copied: keep it unchanged while the view shows it. Recycling it is harmless; the view then
     *     keeps what it shows, in the size and the colours that it had, and the listener hears of it.
     * @throws IllegalArgumentException for a bitmap that is recycled
     */
    public void setPicture(@NonNull Bitmap picture) {
        setPictures(picture, picture, null);
    }

    /**
     * Shows a picture, which is decoded on another thread. The last picture stays until then, and also where the new one
     * cannot be decoded, of which the listener hears. Of several asked for, the last one is shown.
     *
     * @param picture a drawable that is a bitmap
     */
    public void setPicture(@DrawableRes int picture) {
        setSources(picture, picture, null);
    }

    /**
     * Shows a picture that the app may read, as {@link #setPicture(int)} does, turned upright.
     *
     * @param picture of a content provider or a file
     */
    public void setPicture(@NonNull Uri picture) {
        setSources(picture, picture, null);
    }

    /**
     * Shows one picture in an upright view and another in a wide one.
     *
     * @param portrait null for the other one
     * @param landscape null for the other one
     * @param light what the waves throw back, a square picture; null for the module's own
     * @throws IllegalArgumentException for a bitmap that is recycled, or where both backgrounds are null
     */
    public void setPictures(@Nullable Bitmap portrait, @Nullable Bitmap landscape, @Nullable Bitmap light) {
        for (Bitmap bitmap : new Bitmap[] {portrait, landscape, light}) {
            if (bitmap != null && bitmap.isRecycled()) throw new IllegalArgumentException("a picture is recycled");
        }
        setSources(portrait, landscape, light);
    }

    /**
     * As {@link #setPictures(Bitmap, Bitmap, Bitmap)}, decoded on another thread.
     *
     * @param portrait 0 for the other one
     * @param landscape 0 for the other one
     * @param light 0 for the module's own
     * @throws IllegalArgumentException where both backgrounds are 0
     */
    public void setPictures(@DrawableRes int portrait, @DrawableRes int landscape, @DrawableRes int light) {
        setSources(sourceOf(portrait), sourceOf(landscape), sourceOf(light));
    }

    /**
     * Sets the look, the ink and the rain. The picture stays: the module has none of the {@link Preset#ground grounds},
     * which an app may bring.
     *
     * @param preset a look by name
     */
    public void setPreset(@NonNull Preset preset) {
        setLook(preset.look());
        setInk(preset.ink);
        setRain(preset.rain);
    }

    /**
     * Changes how the water looks and moves; the water and the ink stay.
     *
     * @param look is copied
     * @throws IllegalArgumentException naming a value that is beyond its limits; nothing changes
     */
    public void setLook(@NonNull Look look) {
        Look copy = look.clone();
        copy.forEach(Look::checked);
        if (copy.equals(choices.look)) return;
        choices.look = copy;
        applyLook();
    }

    /**
     * How the water looks and moves.
     *
     * @return a copy
     */
    @NonNull
    public Look getLook() {
        return choices.look.clone();
    }

    /**
     * Switches the ink; it is off at first. A switch lets all ink vanish.
     *
     * @param withInk whether touches drop ink
     */
    public void setInk(boolean withInk) {
        choices.withInk = withInk;
        renderer.change(water -> water.setInk(withInk));
    }

    /**
     * Whether touches drop ink.
     *
     * @return as set last
     */
    public boolean getInk() {
        return choices.withInk;
    }

    /**
     * Colours the ink, that which is there as well; it changes the look.
     *
     * @param color without alpha. Channels brighter than three quarters count as three quarters.
     */
    public void setInkColor(@ColorInt int color) {
        Look look = getLook();
        look.inkRed = Math.min((color >> 16 & 255) / 255f, BRIGHTEST_INK);
        look.inkGreen = Math.min((color >> 8 & 255) / 255f, BRIGHTEST_INK);
        look.inkBlue = Math.min((color & 255) / 255f, BRIGHTEST_INK);
        setLook(look);
    }

    /**
     * The colour of the ink.
     *
     * @return opaque
     */
    @ColorInt
    public int getInkColor() {
        Look look = choices.look;
        int red = Math.round(255 * look.inkRed);
        int green = Math.round(255 * look.inkGreen);
        return 0xff000000 | red << 16 | green << 8 | Math.round(255 * look.inkBlue);
    }

    /** Lets all ink vanish. */
    public void clearInk() {
        renderer.change(NativeWater::clearInk);
    }

    /**
     * Lets it rain; it does not at first. Changes the look where it rains.
     *
     * @param dropsPerSecond 0 for no rain
     * @throws IllegalArgumentException beyond the limits of {@link Look#rainDropsPerSecond}
     */
    public void setRain(@FloatRange(from = 0, to = 1000) float dropsPerSecond) {
        if (dropsPerSecond != 0) {
            Look look = getLook();
            look.rainDropsPerSecond = dropsPerSecond;
            setLook(look);
        }
        choices.rains = dropsPerSecond != 0;
        applyRain();
    }

    /**
     * Lets it rain as much as the look says, or not.
     *
     * @param falling whether it rains
     */
    public void setRain(boolean falling) {
        setRain(falling ? choices.look.rainDropsPerSecond : 0);
    }

    /**
     * How much it rains.
     *
     * @return drops a second
     */
    public float getRain() {
        return choices.rains ? choices.look.rainDropsPerSecond : 0;
    }

    /**
     * Lets the breeze of the look blow for good, so that the view never stops drawing. It otherwise sinks some seconds
     * after a touch. {@link Motion#REDUCED} has no breeze.
     *
     * @param always false at first
     */
    public void setBreezeAlways(boolean always) {
        choices.breezeAlways = always;
        renderer.change(water -> water.setBreezeAlways(always));
    }

    /**
     * Whether the breeze blows for good.
     *
     * @return as set last
     */
    public boolean getBreezeAlways() {
        return choices.breezeAlways;
    }

    /**
     * Chooses how many pixels are drawn; {@link Quality#AUTO} at first.
     *
     * @param quality at the cost of time and of battery
     */
    public void setQuality(@NonNull Quality quality) {
        choices.quality = quality;
        if (choices.hasView()) renderer.change(water -> water.setQuality(quality.ordinal()));
    }

    /**
     * How many pixels are drawn.
     *
     * @return as set last
     */
    @NonNull
    public Quality getQuality() {
        return choices.quality;
    }

    /**
     * Chooses what touches do; {@link Interaction#PRESS} at first. A disabled view takes none, nor does one without a
     * picture.
     *
     * @param interaction from the next touch on
     */
    public void setInteraction(@NonNull Interaction interaction) {
        this.interaction = interaction;
    }

    /**
     * Returns the effect of touches.
     *
     * @return as set last
     */
    @NonNull
    public Interaction getInteraction() {
        return interaction;
    }

    /**
     * Chooses whether the water moves by itself; {@link Motion#AUTO} at first.
     *
     * @param motion for the rain, the breeze and the first drop
     */
    public void setMotion(@NonNull Motion motion) {
        this.motion = motion;
        applyMotion();
    }

    /**
     * Whether the water moves by itself.
     *
     * @return as set last
     */
    @NonNull
    public Motion getMotion() {
        return motion;
    }

    /**
     * Lets one drop fall by itself soon after the first frame, to show that this is water.
     *
     * @param falling before the first frame
     */
    public void setFirstDrop(boolean falling) {
        firstDrop = falling;
    }

    /**
     * Whether one drop falls by itself.
     *
     * @return as set last
     */
    public boolean getFirstDrop() {
        return firstDrop;
    }

    /**
     * Lets a drop fall without ink, as {@link #drop(float, float, float, boolean)}.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     */
    public void drop(float x, float y) {
        drop(x, y, 1, false);
    }

    /**
     * Lets a drop fall. Before the first frame it waits for that; in a view that another one keeps from drawing, or that
     * is no longer seen, nothing happens.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param strength 1 for that of a finger; with ink, 0.3 to 1.5 count
     * @param withInk whether it drops ink, where the ink is on
     */
    public void drop(float x, float y, float strength, boolean withInk) {
        renderer.drop(x / Math.max(width, 1), y / Math.max(height, 1), strength, withInk);
    }

    /**
     * Draws a stroke as a finger would: it ripples, and drops ink where the ink is on. Nothing happens in a view that does
     * not draw. A stroke replaces the one before.
     *
     * @param points x and y of one point after the other, in pixels of the view
     * @param milliseconds that the stroke takes, the same time from each point to the next
     * @throws IllegalArgumentException for less than one point, or half a point
     */
    public void stroke(@NonNull float[] points, int milliseconds) {
        if (points.length < 2 || points.length % 2 != 0) throw new IllegalArgumentException("points are pairs");
        float[] shares = points.clone();
        for (int i = 0; i < shares.length; ++i) shares[i] /= Math.max(i % 2 == 0 ? width : height, 1);
        renderer.stroke(shares, Math.max(milliseconds, 1) * TidemarkRenderer.MILLISECOND);
    }

    /** Lets the water stand still until {@link #play}. */
    public void pause() {
        choices.isPaused = true;
        finger.lift();
        renderer.setPaused(true);
    }

    /** Lets the water go on after {@link #pause}. */
    public void play() {
        choices.isPaused = false;
        renderer.setPaused(false);
    }

    /**
     * Whether the water stands still.
     *
     * @return since {@link #pause}
     */
    public boolean isPaused() {
        return choices.isPaused;
    }

    /**
     * The water as a picture. Waits for a frame, some milliseconds.
     *
     * @return a bitmap of its own, of as many pixels as are drawn; null where the view does not draw now
     */
    @Nullable
    public Bitmap toBitmap() {
        return renderer.toBitmap();
    }

    /**
     * Draws on a surface of the app's own instead of in a window, for example on that of a live wallpaper. Hand touches to
     * {@link #onTouchEvent} then. When the method returns, the former surface is no longer used.
     *
     * @param surface null as long as it is not seen
     * @param width of the surface, pixels
     * @param height of the surface, pixels
     */
    public void drawOn(@Nullable Surface surface, int width, int height) {
        if (surface != null) {
            this.width = width;
            this.height = height;
        }
        setWindow(surface, width, height);
    }

    /** Draws where the first finger is. A short tap is a click, and a finger that rests a long click. */
    @Override
    public boolean onTouchEvent(@NonNull MotionEvent event) {
        if (!takesTouches()) {
            finger.lift();
            return super.onTouchEvent(event);
        }
        finger.follow(event);
        gestures.onTouchEvent(event);
        if (event.getActionMasked() == MotionEvent.ACTION_DOWN && interaction == Interaction.PRESS) claimFinger();
        return true;
    }

    // A list around the view would take the finger's way for scrolling.
    void claimFinger() {
        if (getParent() != null) getParent().requestDisallowInterceptTouchEvent(true);
    }

    @Override
    protected void onSizeChanged(int width, int height, int oldWidth, int oldHeight) {
        super.onSizeChanged(width, height, oldWidth, oldHeight);
        if (width == 0 || height == 0) return;
        this.width = width;
        this.height = height;
        double density = context.getResources().getDisplayMetrics().density;
        choices.density = density;
        choices.width = width / density;
        choices.height = height / density;
        double now = choices.isPaused ? 0 : TidemarkRenderer.now();
        int quality = choices.quality.ordinal();
        renderer.change(water -> {
            water.setQuality(quality);
            water.setView(width / density, height / density, density, now);
        });
    }

    @Override
    protected void onWindowVisibilityChanged(int visibility) {
        super.onWindowVisibilityChanged(visibility);
        if (surface != null) surface.setSeen(visibility == VISIBLE);
    }

    @Override
    protected void onDetachedFromWindow() {
        super.onDetachedFromWindow();
        setWindow(null, 0, 0);
        renderer.end();
    }

    @Override
    protected Parcelable onSaveInstanceState() {
        Bundle state = new Bundle();
        state.putParcelable("view", super.onSaveInstanceState());
        for (int i = 0; i < sources.length; ++i) {
            if (sources[i] instanceof Integer) state.putInt("resource" + i, (Integer) sources[i]);
            if (sources[i] instanceof Uri) state.putParcelable("uri" + i, (Uri) sources[i]);
        }
        state.putBoolean("ink", getInk());
        state.putFloat("rain", getRain());
        return state;
    }

    @Override
    protected void onRestoreInstanceState(Parcelable saved) {
        Bundle state = (Bundle) saved;
        state.setClassLoader(getClass().getClassLoader());
        super.onRestoreInstanceState(state.getParcelable("view"));
        Object[] kept = new Object[sources.length];
        for (int i = 0; i < kept.length; ++i) {
            int resource = state.getInt("resource" + i);
            kept[i] = resource != 0 ? resource : state.getParcelable("uri" + i);
        }
        if (kept[0] != null || kept[1] != null) setSources(kept);
        setInk(state.getBoolean("ink"));
        setRain(state.getFloat("rain"));
    }

    private static Object sourceOf(int resource) {
        return resource == 0 ? null : resource;
    }

    // Idempotent, so that what composes its views anew may call it again.
    private void setSources(Object... asked) {
        if (asked[0] == null) asked[0] = asked[1];
        if (asked[1] == null) asked[1] = asked[0];
        if (asked[0] == null) throw new IllegalArgumentException("there is no picture");
        if (Arrays.equals(asked, sources)) return;
        sources = asked;
        int mine = ++ticket;
        int longestSide = longestSideOfDisplay();
        PictureLoader.post(() -> {
            try {
                Bitmap portrait = PictureLoader.load(context, asked[0], longestSide);
                Bitmap landscape =
                        asked[1].equals(asked[0]) ? portrait : PictureLoader.load(context, asked[1], longestSide);
                Object light = asked[2] == null ? R.drawable.tidemark_light : asked[2];
                Pictures pictures = new Pictures(portrait, landscape, PictureLoader.load(context, light, longestSide));
                events.post(() -> {
                    if (mine != ticket) return;
                    shown = asked;
                    choices.pictures = pictures;
                    renderer.change(water -> water.setPictures(pictures));
                });
            } catch (IOException | RuntimeException | OutOfMemoryError e) {
                events.post(() -> {
                    if (mine != ticket) return;
                    sources = shown;
                    events.fails(TidemarkListener.Failure.PICTURE, e.toString());
                });
            }
        });
    }

    private int longestSideOfDisplay() {
        DisplayMetrics display = context.getResources().getDisplayMetrics();
        return Math.max(display.widthPixels, display.heightPixels);
    }

    private void setWindow(Object window, int width, int height) {
        if (window == null) {
            finger.lift();
        } else {
            GlThread.start(context);
            applyMotion();  // the user may come from the system's settings
        }
        renderer.setWindow(window, width, height, choices);
    }

    private boolean takesTouches() {
        boolean isWater = choices.pictures != null && !events.isBroken;
        return isWater && isEnabled() && !choices.isPaused && interaction != Interaction.NONE;
    }

    private void touch(int action, float x, float y, boolean isStylus, float pressure, long time) {
        renderer.touch(action, x / width, y / height, isStylus, pressure, time);
    }

    private void applyMotion() {
        boolean wasReduced = choices.isReduced;
        choices.isReduced = motion == Motion.REDUCED || motion == Motion.AUTO && hasAnimationsOff();
        if (choices.isReduced == wasReduced) return;
        applyLook();
        applyRain();
    }

    private void applyLook() {
        Look look = choices.lookInMotion();
        renderer.change(water -> water.setLook(look));
    }

    private void applyRain() {
        boolean falls = choices.rainFalls();
        renderer.change(water -> water.setRain(falls));
    }

    private boolean hasAnimationsOff() {
        return !isInEditMode() && Settings.Global.getFloat(
                context.getContentResolver(), Settings.Global.ANIMATOR_DURATION_SCALE, 1) == 0;
    }

    private final class Taps extends GestureDetector.SimpleOnGestureListener {
        @Override
        public boolean onSingleTapUp(MotionEvent event) {
            return performClick();
        }

        @Override
        public void onLongPress(MotionEvent event) {
            performLongClick();
        }
    }

    /** What the renderer tells, for the listener that is there then or later. */
    private final class Events implements TidemarkRenderer.View {
        private final Handler main = new Handler(Looper.getMainLooper());
        private TidemarkListener listener;
        private TidemarkRenderer.State state = TidemarkRenderer.State.NOT_READY;
        private boolean isReady;
        private boolean isBroken;
        private TidemarkListener.Failure failure;
        private String message;

        void post(Runnable call) {
            main.post(call);
        }

        void setListener(TidemarkListener listener) {
            this.listener = listener;
            if (listener == null) return;
            if (failure != null) listener.onFailure(failure, message);
            if (isReady) listener.onReady();
            if (state == TidemarkRenderer.State.CALM) listener.onCalm();
            if (state == TidemarkRenderer.State.RESTING) listener.onRest();
        }

        @Override
        public void becomes(TidemarkRenderer.State next) {
            boolean rests = next == TidemarkRenderer.State.RESTING;
            boolean becomesReady = !rests && !isReady;
            state = next;
            isReady |= !rests;
            if (rests) finger.lift();
            if (becomesReady && firstDrop && !choices.isReduced) {
                main.postDelayed(() -> drop(FIRST_DROP_X * width, FIRST_DROP_Y * height), FIRST_DROP_DELAY);
            }
            if (listener == null) return;
            if (becomesReady) listener.onReady();
            if (rests) {
                listener.onRest();
            } else if (next == TidemarkRenderer.State.CALM) {
                listener.onCalm();
            } else if (!becomesReady) {
                listener.onWake();
            }
        }

        @Override
        public void fails(TidemarkListener.Failure failure, String message) {
            this.failure = failure;
            this.message = message;
            isBroken |= failure != TidemarkListener.Failure.PICTURE;
            if (listener != null) listener.onFailure(failure, message);
        }

        @Override
        public void setSurfaceSize(int width, int height) {
            if (surface != null) surface.setSize(width, height);
        }
    }
}
