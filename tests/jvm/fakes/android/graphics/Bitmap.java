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

    /** As the platform's filter, which takes four pixels for one, however many there are. */
    public static Bitmap createScaledBitmap(Bitmap source, int width, int height, boolean filter) {
        int[] colors = new int[width * height];
        for (int i = 0; i < colors.length; ++i) {
            int x = i % width * source.width / width;
            int y = i / width * source.height / height;
            for (int shift = 0; shift < 32; shift += 8) {
                int sum = 2;
                for (int at = 0; at < 4; ++at) {
                    int column = Math.min(x + at % 2, source.width - 1);
                    int row = Math.min(y + at / 2, source.height - 1);
                    sum += source.colors[row * source.width + column] >>> shift & 255;
                }
                colors[i] |= sum / 4 << shift;
            }
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
