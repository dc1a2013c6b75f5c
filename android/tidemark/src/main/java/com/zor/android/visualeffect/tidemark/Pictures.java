package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;

import org.jetbrains.annotations.NotNull;

/** The three pictures of the effect. The backgrounds may be larger or of other proportions than the view. */
public final class Pictures {
    /** All three, as a sum of 1, 2 and 4. */
    static final int ALL = 7;

    private static final int LIGHT = 2;

    private final Bitmap[] slots;

    /**
     * Keeps the bitmaps themselves.
     *
     * @param portrait what the water lies over in an upright view
     * @param landscape and in a wide one
     * @param light on the waves, of any proportions
     * @throws IllegalArgumentException for a bitmap that is null or recycled
     */
    public Pictures(@NotNull Bitmap portrait, @NotNull Bitmap landscape, @NotNull Bitmap light) {
        slots = new Bitmap[] {usable(portrait, "portrait"), usable(landscape, "landscape"), usable(light, "light")};
    }

    /** Those that are other bitmaps than in {@code before}, which may be null. */
    int newSince(Pictures before) {
        int which = 0;
        for (int i = 0; i < slots.length; ++i) {
            if (before == null || slots[i] != before.slots[i]) which |= 1 << i;
        }
        return which;
    }

    /** In pixels. */
    int longestSideOfLight() {
        return Math.max(slots[LIGHT].getWidth(), slots[LIGHT].getHeight());
    }

    /**
     * Of a background the middle part that has the proportions width : height, with at most so many pixels; of the light
     * all. Four bytes a pixel.
     */
    Bitmap fitted(int slot, int width, int height) {
        Bitmap picture = slot == LIGHT ? slots[LIGHT] : scaled(cropped(slots[slot], width, height), width, height);
        Bitmap.Config rgba = Bitmap.Config.ARGB_8888;
        return picture.getConfig() == rgba ? picture : picture.copy(rgba, false);
    }

    private static Bitmap scaled(Bitmap picture, int width, int height) {
        // The filter takes the mean of four pixels, so that none is left out where a side shrinks by half at most.
        while (picture.getWidth() > width || picture.getHeight() > height) {
            picture = Bitmap.createScaledBitmap(picture, Math.max(width, (picture.getWidth() + 1) / 2),
                    Math.max(height, (picture.getHeight() + 1) / 2), true);
        }
        return picture;
    }

    private static Bitmap cropped(Bitmap picture, int width, int height) {
        double aspect = (double) width / height;
        int columns = within((int) Math.round(picture.getHeight() * aspect), picture.getWidth());
        int rows = within((int) Math.round(picture.getWidth() / aspect), picture.getHeight());
        int left = (picture.getWidth() - columns) / 2;
        int top = (picture.getHeight() - rows) / 2;
        return Bitmap.createBitmap(picture, left, top, columns, rows);
    }

    private static Bitmap usable(Bitmap bitmap, String name) {
        if (bitmap == null || bitmap.isRecycled()) {
            throw new IllegalArgumentException("the picture for " + name + (bitmap == null ? " is null" : " is recycled"));
        }
        return bitmap;
    }

    private static int within(int side, int most) {
        return Math.max(1, Math.min(side, most));
    }
}
