package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

/** The three pictures of the effect. The backgrounds may be larger or of other proportions than the view. */
public final class Pictures {
    private final Bitmap portrait;
    private final Bitmap landscape;
    private final Bitmap water;

    /** Background of an upright view, background of a view held across, and the light on the waves. */
    public Pictures(Bitmap portrait, Bitmap landscape, Bitmap water) {
        this.portrait = portrait;
        this.landscape = landscape;
        this.water = water;
    }

    void handOver(JniTidemarkRender library, int shorter, int longer) {
        library.transferPortraitBGBitmap(asRgba(cropToAspect(portrait, shorter, longer)));
        library.transferLandscapeBGBitmap(asRgba(cropToAspect(landscape, longer, shorter)));
        library.transferWaterBitmap(asRgba(water));
    }

    /** The largest middle part of {@code picture} that has the proportions aspectWidth : aspectHeight. */
    static Bitmap cropToAspect(Bitmap picture, double aspectWidth, double aspectHeight) {
        double aspect = aspectWidth / aspectHeight;
        int width = within((int) Math.round(picture.getHeight() * aspect), picture.getWidth());
        int height = within((int) Math.round(picture.getWidth() / aspect), picture.getHeight());
        int left = (picture.getWidth() - width) / 2;
        int top = (picture.getHeight() - height) / 2;
        return Bitmap.createBitmap(picture, left, top, width, height);
    }

    private static int within(int side, int most) {
        return Math.max(1, Math.min(side, most));
    }

    // The library reads four bytes a pixel, whatever the bitmap holds.
    private static Bitmap asRgba(Bitmap bitmap) {
        Bitmap.Config rgba = Bitmap.Config.ARGB_8888;
        return bitmap.getConfig() == rgba ? bitmap : bitmap.copy(rgba, false);
    }
}
