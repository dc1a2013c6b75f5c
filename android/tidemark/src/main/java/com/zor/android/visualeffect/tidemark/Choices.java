package com.zor.android.visualeffect.tidemark;

/** The settings of a view, kept for its getters and for the water that is made when the view is first shown. */
final class Choices implements Cloneable {
    Look look = new Look();
    boolean withInk;
    boolean rains;
    boolean breezeAlways;
    boolean isReduced;  // only touches move the water
    boolean isPaused;
    Quality quality = Quality.AUTO;
    Pictures pictures;  // null before the first ones are decoded

    // The view in density-independent pixels, 0 where all that is known is a surface.
    double width;
    double height;
    double density;

    boolean hasView() {
        return width > 0 && height > 0;
    }

    boolean rainFalls() {
        return rains && !isReduced;
    }

    Look lookInMotion() {
        Look result = look.clone();
        if (isReduced) result.breeze = 0;
        return result;
    }

    void applyTo(NativeWater water) {
        water.setQuality(quality.ordinal());
        if (hasView()) water.setView(width, height, density, TidemarkRenderer.now());
        water.setLook(lookInMotion());
        water.setInk(withInk);
        water.setRain(rainFalls());
        water.setBreezeAlways(breezeAlways);
        if (pictures != null) water.setPictures(pictures);
    }

    @Override
    public Choices clone() {
        try {
            Choices copy = (Choices) super.clone();
            copy.look = look.clone();
            return copy;
        } catch (CloneNotSupportedException e) {
            throw new AssertionError(e);
        }
    }
}
