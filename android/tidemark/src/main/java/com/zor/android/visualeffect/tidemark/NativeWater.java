package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

/**
 * The native part of a view's water. Each native method calls the method of the same name in {@code host/live_water.h},
 * which documents it. Used on {@link GlThread}; {@link #frame} needs the current context.
 */
final class NativeWater {
    interface FailureListener {
        /** Called when a picture cannot be passed to the library. */
        void pictureFailed(String message);
    }

    /** Returned by {@link #frame} when it has drawn. */
    static final int DRAWN = 2;
    /** Returned by {@link #frame} when the surface must get {@link #width} x {@link #height} pixels first. */
    static final int RESIZE = 3;

    static {
        System.loadLibrary("TidemarkEffect");
        System.loadLibrary("TidemarkHost");
    }

    private final long handle;
    private final FailureListener failures;
    private Pictures pictures;
    private Look look;
    private int inLibrary;  // the slots whose picture the library has from this water, as a sum of 1, 2 and 4

    NativeWater(int seed, FailureListener failures) {
        this.failures = failures;
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

    /** Called when the library has the pictures of another water, or none. */
    void renewPictures() {
        inLibrary = 0;
        if (pictures != null) picturesChanged(Pictures.ALL);
    }

    void setLook(Look look) {
        if (look.equals(this.look)) return;
        this.look = look;
        look.forEach((name, value, least, most, isWhole) -> {
            if (!setLookValue(name, value)) throw new IllegalArgumentException(name + " cannot be " + value);
            return value;
        });
        applyLook();
    }

    // Called by the native code during frame(). With null the library keeps the picture that it has.
    private Bitmap picture(int slot, int width, int height) {
        try {
            Bitmap fitted = pictures.fitted(slot, width, height);
            Pictures.multiply(fitted, shade(slot, Pictures.brightness(fitted)));
            inLibrary |= 1 << slot;
            return fitted;
        } catch (RuntimeException | OutOfMemoryError e) {  // recycled meanwhile, or too large
            failures.pictureFailed("a picture cannot be used: " + e);
            return (inLibrary & 1 << slot) != 0 ? null : Pictures.pixel();
        }
    }

    // Frees native memory. No call tells a view that its app no longer uses it.
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
