package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.provider.Settings;

/** The settings of a view. The main thread changes them, and passes copies to the thread that draws. */
final class WaterSettings implements Cloneable {
    Look look = new Look();  // never changed, but replaced
    boolean withInk;
    boolean rains;
    boolean breezeAlways;
    Motion motion = Motion.AUTO;
    boolean isReduced;  // follows from `motion` and the system's settings
    boolean isPaused;
    Quality quality = Quality.AUTO;
    Pictures pictures;  // null until the first ones are decoded

    // The size of the view in density-independent pixels; 0 if the app draws on a surface of its own.
    private double width;
    private double height;
    private double density;

    void setView(int pixelWidth, int pixelHeight, double density) {
        width = pixelWidth / density;
        height = pixelHeight / density;
        this.density = density;
    }

    boolean hasView() {
        return width > 0;
    }

    void updateReduced(Context context) {
        isReduced = motion == Motion.REDUCED || motion == Motion.AUTO && Settings.Global.getFloat(
                context.getContentResolver(), Settings.Global.ANIMATOR_DURATION_SCALE, 1) == 0;
    }

    void applyTo(NativeWater water) {
        if (hasView()) {
            water.setQuality(quality.ordinal());
            // A paused view draws at the time of its last frame. A new size of time 0 has settled by then.
            water.setView(width, height, density, isPaused ? 0 : TidemarkRenderer.now());
        }
        Look inMotion = look.clone();
        if (isReduced) inMotion.breeze = 0;
        water.setLook(inMotion);
        water.setInk(withInk);
        water.setRain(rains && !isReduced);
        water.setBreezeAlways(breezeAlways);
        if (pictures != null) water.setPictures(pictures);
    }

    @Override
    public WaterSettings clone() {
        try {
            return (WaterSettings) super.clone();
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }
}
