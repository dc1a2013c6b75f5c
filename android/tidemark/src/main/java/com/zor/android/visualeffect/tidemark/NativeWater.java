package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

/**
 * Water on a screen that is looked at: {@code host/live_water.h} method by method, where each is documented. Call
 * everything on {@link GlThread}, {@link #frame} with the context current.
 */
final class NativeWater {
    /** Hears of a picture that cannot be handed over. */
    interface Complaints {
        void hear(String message);
    }

    /** Of what {@link #frame} answers: the framebuffer holds another picture. */
    static final int DRAWN = 2;
    /** The surface must first have {@link #width} x {@link #height} pixels. */
    static final int RESIZE = 3;

    static {
        System.loadLibrary("TidemarkEffect");
        System.loadLibrary("TidemarkHost");
    }

    private final long handle;
    private final Complaints complaints;
    private Pictures pictures;
    private int handedOver;  // pictures that the library has from this water, as a sum

    NativeWater(int seed, Complaints complaints) {
        this.complaints = complaints;
        handle = create(seed);
    }

    boolean hasPictures() {
        return pictures != null;
    }

    void setPictures(Pictures pictures) {
        int changed = pictures.newSince(this.pictures);
        this.pictures = pictures;
        picturesChanged(changed);
    }

    /** The library has another water's, or none. */
    void renewPictures() {
        handedOver = 0;
        if (pictures != null) picturesChanged(Pictures.ALL);
    }

    void setLook(Look look) {
        look.forEach((name, value, least, most, isWhole) -> {
            if (!setLookValue(name, value)) throw new IllegalArgumentException(name + " cannot be " + value);
            return value;
        });
        applyLook();
    }

    // Called in the middle of a frame. Null leaves the library the picture that it has.
    private Bitmap picture(int slot, int width, int height) {
        try {
            Bitmap fitted = pictures.fitted(slot, width, height);
            Pictures.multiply(fitted, shade(slot, Pictures.brightness(fitted)));
            handedOver |= 1 << slot;
            return fitted;
        } catch (RuntimeException | OutOfMemoryError e) {  // recycled meanwhile, or too large
            complaints.hear("a picture cannot be used: " + e);
            return (handedOver & 1 << slot) != 0 ? null : Pictures.pixel();
        }
    }

    // Its memory is not the virtual machine's, and a view does not hear that nobody wants it any more.
    @Override
    protected void finalize() {
        destroy();
    }

    private static native long create(int seed);

    private native void destroy();

    native void setView(double width, double height, double density, double now);

    native void setQuality(int quality);

    native int width();

    native int height();

    native void resized();

    private native boolean setLookValue(String name, double value);

    private native void applyLook();

    native void setInk(boolean withInk);

    native void setRain(boolean falling);

    native void setBreezeAlways(boolean always);

    private native int shade(int slot, float brightness);

    native void clearInk();

    native void touch(int action, float x, float y, boolean isStylus, float pressure, double time);

    native void splash(float x, float y, float weight, boolean withInk);

    private native void picturesChanged(int which);

    native void redraw();

    native void renewContext();

    native int frame(double now);

    native double due();
}
