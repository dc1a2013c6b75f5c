package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

import org.jetbrains.annotations.NotNull;

/** The three pictures of the effect. The backgrounds may be larger or of other proportions than the view. */
public final class Pictures {
    /** Of the numbers that say which pictures, as a sum. */
    public static final int PORTRAIT = 1;
    /** Of these. */
    public static final int LANDSCAPE = 2;
    /** Both. */
    public static final int BACKGROUNDS = 3;
    /** On the waves. */
    public static final int LIGHT = 4;
    /** All three. */
    public static final int ALL = 7;

    private final Bitmap portrait;
    private final Bitmap landscape;
    private final Bitmap light;
    private final Object library;  // another one when the library has lost the pictures

    /**
     * Keeps the bitmaps themselves.
     *
     * @param portrait what the water lies over in an upright view
     * @param landscape and in a wide one
     * @param light on the waves, of any proportions
     * @throws IllegalArgumentException for a bitmap that is null or recycled
     */
    public Pictures(@NotNull Bitmap portrait, @NotNull Bitmap landscape, @NotNull Bitmap light) {
        this.portrait = usable(portrait, "portrait");
        this.landscape = usable(landscape, "landscape");
        this.light = usable(light, "light");
        library = null;
    }

    private Pictures(Pictures other) {
        portrait = other.portrait;
        landscape = other.landscape;
        light = other.light;
        library = new Object();
    }

    /** The same bitmaps, all to be handed over again. */
    Pictures asNew() {
        return new Pictures(this);
    }

    /** In pixels. */
    int longestSide() {
        return Math.max(longestSide(portrait), Math.max(longestSide(landscape), longestSide(light)));
    }

    /** Those that are other bitmaps than in {@code before}, which may be null. */
    int newSince(Pictures before) {
        if (before == null || library != null && library != before.library) return ALL;
        return (portrait == before.portrait ? 0 : PORTRAIT) | (landscape == before.landscape ? 0 : LANDSCAPE)
                | (light == before.light ? 0 : LIGHT);
    }

    void handOver(JniTidemarkRender library, int which, int shorter, int longer) {
        if ((which & PORTRAIT) != 0) {
            library.transferPortraitBGBitmap(asRgba(cropToAspect(portrait, shorter, longer)));
        }
        if ((which & LANDSCAPE) != 0) {
            library.transferLandscapeBGBitmap(asRgba(cropToAspect(landscape, longer, shorter)));
        }
        if ((which & LIGHT) != 0) library.transferWaterBitmap(asRgba(light));
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

    private static Bitmap usable(Bitmap bitmap, String name) {
        if (bitmap == null || bitmap.isRecycled()) {
            throw new IllegalArgumentException("the picture for " + name + (bitmap == null ? " is null" : " is recycled"));
        }
        return bitmap;
    }

    private static int longestSide(Bitmap bitmap) {
        return Math.max(bitmap.getWidth(), bitmap.getHeight());
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
