package com.zor.android.visualeffect.tidemark;

import android.graphics.Bitmap;
import android.graphics.Canvas;
import android.graphics.Paint;
import android.graphics.PorterDuff;
import android.graphics.Rect;

import java.nio.ByteBuffer;

/** The three decoded pictures of the effect. The backgrounds may have any size and proportions. */
final class Pictures {
    /** The slots of all three pictures, as a sum of 1, 2 and 4. */
    static final int ALL = 7;

    private static final int LIGHT = 2;
    private static final int LONGEST_SIDE_OF_LIGHT = 1024;
    private static final int WHITE = 0xffffffff;
    private static final int DARK_BLUE = 0xff0d3b4f;

    private final Bitmap[] slots;

    /** Takes the pictures for portrait, for landscape, and of the light. */
    Pictures(Bitmap... slots) {
        this.slots = slots;
    }

    /** Returns the slots that have another bitmap than in {@code before}, as a sum. {@code before} may be null. */
    int newSince(Pictures before) {
        int which = 0;
        for (int i = 0; i < slots.length; ++i) {
            if (before == null || slots[i] != before.slots[i]) which |= 1 << i;
        }
        return which;
    }

    /**
     * Returns a bitmap in the form that the library takes: RGBA with 8 bits each, sRGB, without padding between rows. A
     * background is cropped to the proportions width : height around its middle, and scaled down to that size.
     */
    Bitmap fitted(int slot, int width, int height) {
        Bitmap picture = slots[slot];
        if (slot != LIGHT) return scaled(picture, middle(picture, width, height), width, height);
        Rect whole = new Rect(0, 0, picture.getWidth(), picture.getHeight());
        return scaled(picture, whole, LONGEST_SIDE_OF_LIGHT, LONGEST_SIDE_OF_LIGHT);
    }

    /** Returns the mean of red, green and blue, 0 to 1. */
    static float brightness(Bitmap picture) {
        int mean = scaled(picture, new Rect(0, 0, picture.getWidth(), picture.getHeight()), 1, 1).getPixel(0, 0);
        return ((mean >> 16 & 255) + (mean >> 8 & 255) + (mean & 255)) / (3 * 255f);
    }

    /** Multiplies a bitmap that {@link #fitted} has returned by an opaque colour. */
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
        // A software canvas cannot draw a bitmap in graphics memory.
        Bitmap from = isHardware(picture) ? picture.copy(Bitmap.Config.ARGB_8888, false) : picture;
        // The filter averages four pixels, so it skips none only if no side shrinks to less than half.
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
        return picture.getConfig() != null && picture.getConfig().name().equals("HARDWARE");  // since API 26
    }

    /** Returns a small picture in place of a missing one. */
    static Bitmap pixel() {
        return Bitmap.createBitmap(new int[] {DARK_BLUE}, 1, 1, Bitmap.Config.ARGB_8888);
    }

    /** Returns a frame as a bitmap. Its bytes are R, G, B, A, and its rows begin at the bottom. */
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
