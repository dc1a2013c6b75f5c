package com.zor.android.visualeffect.tidemark;

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

    /** {@code seed} fixes where the rain falls. */
    public LiveWater(JniTidemarkRender library, Look look, int seed) {
        host = new WaterHost(library, look, 1, 1, seed);
    }

    /**
     * Nothing is drawn before the first pictures. Hands over only those that are other bitmaps than the last ones; they
     * must stay alive and unchanged.
     */
    public void setPictures(Pictures pictures) {
        handOverDue |= pictures.newSince(this.pictures);
        this.pictures = pictures;
    }

    /** In pixels, each at least 1. The ink is lost, the water stays. */
    public void resize(int width, int height) {
        host.resize(width, height);
        clock.rest();
        setUpDue = true;
    }

    public void setLook(Look look) {
        host.setLook(look);
    }

    /** Whether touches drop ink; they do not at first. A switch ends the stroke that is being drawn. */
    public void setInk(boolean withInk) {
        if (withInk == this.withInk) return;
        this.withInk = withInk;
        setUpDue = true;
    }

    public void setRain(boolean falling) {
        host.rain(falling);
    }

    public void clearInk() {
        host.clearInk();
    }

    /** One touch event, as {@link WaterHost#touch} takes it. */
    public void touch(int action, int x, int y, float pressure) {
        host.touch(action, x, y, pressure);
    }

    /** A ripple without a finger, as {@link WaterHost#splash} takes it. */
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

    /** What the processor spent on the last frame, in seconds; frames that take long make the mesh coarser. */
    public void noteWork(double seconds) {
        host.noteWork(seconds);
    }

    /** Whether there is nothing to draw until the next call that changes something. */
    public boolean isResting() {
        if (pictures == null) return true;
        return !setUpDue && handOverDue == 0 && host.isResting();
    }

    /**
     * Brings the water to the time {@code now}, in seconds of any steady clock, and draws it into the current
     * framebuffer where it has changed.
     */
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
        if (setUpDue) {
            host.setUp(withInk, textures);
        } else {
            host.loadTextures(textures);
        }
        setUpDue = false;
        handOverDue = texturesDue = 0;
    }
}
