package com.zor.android.visualeffect.tidemark;

import org.jetbrains.annotations.NotNull;

/**
 * Water on a screen that is looked at: takes what happens (touches, another size, other pictures, another look) and
 * draws a frame when something has changed.
 *
 * <p>Call everything on the one thread that owns the OpenGL ES 2.0 context; the context itself is needed by
 * {@link #frame} only.
 */
public final class LiveWater {
    /** What {@link #frame} did. */
    public enum Frame {
        /** Nothing to draw until the next call that changes something. */
        RESTING,
        /** Nothing to draw yet. */
        WAITING,
        /** The framebuffer holds another picture. */
        DRAWN
    }

    private final FrameClock clock = new FrameClock();
    private final WaterHost host;
    private Pictures pictures;
    private boolean withInk;

    // What the library has not been told yet; the next frame does, where the context is current.
    private boolean setUpDue = true;
    private int handOverDue;
    private int texturesDue;  // besides those handed over
    private double proportions;  // to which the backgrounds were last cropped
    private boolean prepared;  // what was due, since the last noteWork()

    /**
     * Water that has no size and no pictures yet.
     *
     * @param library whose calls it makes
     * @param look is copied
     * @param seed fixes where the rain falls
     */
    public LiveWater(@NotNull JniTidemarkRender library, @NotNull Look look, int seed) {
        host = new WaterHost(library, look, 1, 1, seed);
    }

    /**
     * Nothing is drawn before the first pictures. Hands over only those that are other bitmaps than the last ones; they
     * must stay alive and unchanged.
     *
     * @param pictures with the bitmaps
     */
    public void setPictures(@NotNull Pictures pictures) {
        handOverDue |= pictures.newSince(this.pictures);
        this.pictures = pictures;
    }

    /**
     * For a view of another size. The ink is lost, the water stays.
     *
     * @param width pixels, at least 1
     * @param height likewise
     */
    public void resize(int width, int height) {
        host.resize(width, height);
        clock.rest();
        setUpDue = true;
    }

    /**
     * Takes over all values; the water and the ink stay.
     *
     * @param look is copied
     */
    public void setLook(@NotNull Look look) {
        host.setLook(look);
    }

    /**
     * Switches the ink; it is off at first. A switch ends the stroke that is being drawn.
     *
     * @param withInk whether touches drop ink
     */
    public void setInk(boolean withInk) {
        if (withInk == this.withInk) return;
        this.withInk = withInk;
        setUpDue = true;
    }

    /**
     * Switches the rain; it is off at first.
     *
     * @param falling whether it rains
     */
    public void setRain(boolean falling) {
        host.rain(falling);
    }

    /** Lets all ink vanish with the next frame. */
    public void clearInk() {
        host.clearInk();
    }

    /**
     * One touch event.
     *
     * @param action one of {@link WaterHost}'s
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param pressure around 1
     */
    public void touch(int action, int x, int y, float pressure) {
        host.touch(action, x, y, pressure);
    }

    /**
     * The ripple of a finger that comes down, without a finger and without ink.
     *
     * @param x pixels from the left edge of the view
     * @param y pixels from its top edge
     * @param pressure around 1
     */
    public void splash(int x, int y, float pressure) {
        host.splash(x, y, pressure);
    }

    /** Where the framebuffer has lost the last frame. */
    public void redraw() {
        host.redraw();
    }

    /** After a lost context. */
    public void renewContext() {
        setUpDue = true;
        texturesDue = Pictures.ALL;
    }

    /**
     * Frames that take long make the mesh coarser, where the look leaves it to the host. One that set the library up or
     * took pictures over says nothing of the next ones.
     *
     * @param seconds that the processor spent on the last frame
     */
    public void noteWork(double seconds) {
        if (!prepared) host.noteWork(seconds);
        prepared = false;
    }

    /**
     * Whether a frame would show anything new.
     *
     * @return true when there is nothing to draw until the next call that changes something
     */
    public boolean isResting() {
        if (pictures == null) return true;
        return !setUpDue && handOverDue == 0 && host.isResting();
    }

    /**
     * Brings the water to the time {@code now} and draws it where it has changed: without ink into the current
     * framebuffer, with ink into framebuffer 0.
     *
     * @param now seconds of any steady clock
     * @return what it did
     */
    @NotNull
    public Frame frame(double now) {
        if (isResting()) {
            clock.rest();
            return Frame.RESTING;
        }
        prepare();
        if (!host.advance(clock.secondsUntil(now))) return Frame.WAITING;
        host.draw();
        if (isResting()) clock.rest();
        return Frame.DRAWN;
    }

    private void prepare() {
        if (host.proportions() != proportions) handOverDue |= Pictures.BACKGROUNDS;
        proportions = host.proportions();
        host.handOver(pictures, handOverDue);
        int textures = handOverDue | texturesDue;
        prepared |= setUpDue || textures != 0;
        if (setUpDue) {
            host.setUp(withInk, textures);
        } else {
            host.loadTextures(textures);
        }
        setUpDue = false;
        handOverDue = texturesDue = 0;
    }
}
