package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;
import android.graphics.Canvas;
import android.graphics.Paint;
import android.graphics.PorterDuff;
import android.graphics.Rect;

import java.nio.ByteBuffer;

/** The three pictures of the effect, decoded. The backgrounds may be larger or of other proportions than the view. */
final class Pictures {
    /** All three, as a sum of 1, 2 and 4. */
    static final int ALL = 7;

    private static final int LIGHT = 2;
    private static final int LONGEST_SIDE_OF_LIGHT = 1024;
    private static final int WHITE = 0xffffffff;
    private static final int DEEP_WATER = 0xff0d3b4f;

    private final Bitmap[] slots;

    /** By slot: portrait, landscape, light. */
    Pictures(Bitmap... slots) {
        this.slots = slots;
    }

    /** Those that are other bitmaps than in {@code before}, which may be null. */
    int newSince(Pictures before) {
        int which = 0;
        for (int i = 0; i < slots.length; ++i) {
            if (before == null || slots[i] != before.slots[i]) which |= 1 << i;
        }
        return which;
    }

    /**
     * A bitmap as the library takes it: four bytes a pixel, in the colours of the display that it knows, without padding
     * between rows. Of a background the middle part that has the proportions width : height, with at most so many pixels;
     * of the light all.
     */
    Bitmap fitted(int slot, int width, int height) {
        Bitmap picture = slots[slot];
        if (slot != LIGHT) return scaled(picture, middle(picture, width, height), width, height);
        Rect whole = new Rect(0, 0, picture.getWidth(), picture.getHeight());
        return scaled(picture, whole, LONGEST_SIDE_OF_LIGHT, LONGEST_SIDE_OF_LIGHT);
    }

    /** The mean of all channels, 0 to 1. */
    static float brightness(Bitmap picture) {
        int mean = scaled(picture, new Rect(0, 0, picture.getWidth(), picture.getHeight()), 1, 1).getPixel(0, 0);
        return ((mean >> 16 & 255) + (mean >> 8 & 255) + (mean & 255)) / (3 * 255f);
    }

    /** Multiplies a bitmap of {@link #fitted} by an opaque colour. */
    static void multiply(Bitmap fitted, int color) {
        if (color != WHITE) new Canvas(fitted).drawColor(color, PorterDuff.Mode.MULTIPLY);
    }

    private static Rect middle(Bitmap picture, int width, int height) {
        double aspect = (double) width / height;
        int columns = within((int) Math.round(picture.getHeight() * aspect), picture.getWidth());
        int rows = within((int) Math.round(picture.getWidth() / aspect), picture.getHeight());
        int left = (picture.getWidth() - columns) / 2;
        int top = (picture.getHeight() - rows) / 2;
        return new Rect(left, top, left + columns, top + rows);
    }

    private static Bitmap scaled(Bitmap picture, Rect part, int width, int height) {
        // A canvas does not draw what only the GPU has.
        Bitmap from = isHardware(picture) ? picture.copy(Bitmap.Config.ARGB_8888, false) : picture;
        // The filter takes the mean of four pixels, so that none is left out where a side shrinks by half at most.
        while (true) {
            int columns = Math.min(part.width(), Math.max(width, (part.width() + 1) / 2));
            int rows = Math.min(part.height(), Math.max(height, (part.height() + 1) / 2));
            Bitmap drawn = Bitmap.createBitmap(columns, rows, Bitmap.Config.ARGB_8888);
            Rect whole = new Rect(0, 0, columns, rows);
            new Canvas(drawn).drawBitmap(from, part, whole, new Paint(Paint.FILTER_BITMAP_FLAG));
            if (from != picture) from.recycle();
            if (columns <= width && rows <= height) return drawn;
            from = drawn;
            part = whole;
        }
    }

    private static boolean isHardware(Bitmap picture) {
        return picture.getConfig() != null && picture.getConfig().name().equals("HARDWARE");  // of API 26
    }

    /** Stands in for a missing picture. */
    static Bitmap pixel() {
        return Bitmap.createBitmap(new int[] {DEEP_WATER}, 1, 1, Bitmap.Config.ARGB_8888);
    }

    /** A frame, whose bytes are R, G, B, A and whose rows are from the bottom. */
    static Bitmap upright(ByteBuffer pixels, int width, int height) {
        byte[] row = new byte[4 * width];
        ByteBuffer turned = ByteBuffer.allocateDirect(4 * width * height);
        for (int y = height - 1; y >= 0; --y) {
            pixels.position(y * row.length);
            pixels.get(row);
            turned.put(row);
        }
        turned.position(0);
        Bitmap picture = Bitmap.createBitmap(width, height, Bitmap.Config.ARGB_8888);
        picture.copyPixelsFromBuffer(turned);
        return picture;
    }

    private static int within(int side, int most) {
        return Math.max(1, Math.min(side, most));
    }
}
