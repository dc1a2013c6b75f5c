package android.graphics;

import java.nio.Buffer;
import java.nio.ByteBuffer;

/** A bitmap with its bytes in a direct buffer, which bitmap.cpp reads. */
public final class Bitmap {
    public enum Config {
        RGB_565,
        ARGB_8888,
        HARDWARE
    }

    /** R, G, B, A, rows from the top; null for other configurations than ARGB_8888. */
    public final ByteBuffer pixels;
    /** The number of locks of all bitmaps that exist now, and that were made since the start. */
    public static int locks;
    public static int locksMade;

    private final int[] colors;
    private final int width;
    private final int height;
    private final Config config;
    private boolean isRecycled;

    private Bitmap(int[] colors, int width, int height, Config config) {
        this.colors = colors;
        this.width = width;
        this.height = height;
        this.config = config;
        pixels = config == Config.ARGB_8888 ? ByteBuffer.allocateDirect(4 * colors.length) : null;
        fill(colors);
    }

    void fill(int[] filling) {
        for (int i = 0; i < colors.length; ++i) {
            colors[i] = filling[i];
            if (pixels != null) pixels.putInt(4 * i, Integer.rotateLeft(filling[i], 8));
        }
    }

    int color(int x, int y) {
        return colors[y * width + x];
    }

    public int getPixel(int x, int y) {
        return color(x, y);
    }

    public static Bitmap createBitmap(int[] colors, int width, int height, Config config) {
        return new Bitmap(colors.clone(), width, height, config);
    }

    public static Bitmap createBitmap(int width, int height, Config config) {
        return new Bitmap(new int[width * height], width, height, config);
    }

    /** Turns a whole bitmap. */
    public static Bitmap createBitmap(Bitmap source, int x, int y, int width, int height, Matrix matrix, boolean filter) {
        int newWidth = matrix.xx == 0 ? height : width;
        int[] colors = new int[width * height];
        for (int i = 0; i < colors.length; ++i) {
            int[] at = matrix.map(2 * (i % width) + 1 - width, 2 * (i / width) + 1 - height);  // twice, from the middle
            colors[(at[1] + colors.length / newWidth - 1) / 2 * newWidth + (at[0] + newWidth - 1) / 2] = source.colors[i];
        }
        return new Bitmap(colors, newWidth, colors.length / newWidth, source.config);
    }

    public Bitmap copy(Config config, boolean mutable) {
        return new Bitmap(colors.clone(), width, height, config);
    }

    public void copyPixelsFromBuffer(Buffer rgba) {
        int[] filling = new int[colors.length];
        for (int i = 0; i < filling.length; ++i) filling[i] = Integer.rotateRight(((ByteBuffer) rgba).getInt(4 * i), 8);
        fill(filling);
    }

    public void recycle() {
        isRecycled = true;
    }

    public boolean isRecycled() {
        return isRecycled;
    }

    public int getWidth() {
        return width;
    }

    public int getHeight() {
        return height;
    }

    public Config getConfig() {
        return config;
    }
}
