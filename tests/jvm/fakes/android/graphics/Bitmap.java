package android.graphics;

import java.nio.ByteBuffer;

/** A picture whose bytes lie in a direct buffer, where the stand-in of libjnigraphics finds them. */
public final class Bitmap {
    public enum Config {
        RGB_565,
        ARGB_8888
    }

    /** R, G, B, A, rows from the top; null where a pixel has not four bytes. */
    public final ByteBuffer pixels;
    /** Locks of all bitmaps that are not yet undone, and those that ever were made. */
    public static int locks;
    public static int locksMade;

    private final int[] colors;
    private final int width;
    private final int height;
    private final Config config;

    private Bitmap(int[] colors, int width, int height, Config config) {
        this.colors = colors;
        this.width = width;
        this.height = height;
        this.config = config;
        pixels = config == Config.ARGB_8888 ? rgba(colors) : null;
    }

    private static ByteBuffer rgba(int[] colors) {
        ByteBuffer bytes = ByteBuffer.allocateDirect(4 * colors.length);
        for (int argb : colors) bytes.putInt(argb << 8 | argb >>> 24);
        return bytes;
    }

    public static Bitmap createBitmap(int[] colors, int width, int height, Config config) {
        return new Bitmap(colors.clone(), width, height, config);
    }

    public static Bitmap createBitmap(Bitmap source, int x, int y, int width, int height) {
        int[] colors = new int[width * height];
        for (int row = 0; row < height; ++row) {
            System.arraycopy(source.colors, (y + row) * source.width + x, colors, row * width, width);
        }
        return new Bitmap(colors, width, height, source.config);
    }

    public Bitmap copy(Config config, boolean mutable) {
        return new Bitmap(colors, width, height, config);
    }

    public boolean isRecycled() {
        return false;
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
