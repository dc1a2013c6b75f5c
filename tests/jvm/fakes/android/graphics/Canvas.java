package android.graphics;

/** Draws a part of a bitmap onto a whole one, and multiplies bitmaps by an opaque colour. */
public class Canvas {
    private final Bitmap target;

    public Canvas(Bitmap target) {
        this.target = target;
    }

    public void drawColor(int color, PorterDuff.Mode mode) {
        if (mode != PorterDuff.Mode.MULTIPLY) throw new IllegalArgumentException(mode.name());
        int[] colors = new int[target.getWidth() * target.getHeight()];
        for (int i = 0; i < colors.length; ++i) {
            int before = target.color(i % target.getWidth(), i / target.getWidth());
            for (int shift = 0; shift < 32; shift += 8) {
                int product = (before >>> shift & 255) * (color >>> shift & 255);
                colors[i] |= (product + 127) / 255 << shift;
            }
        }
        target.fill(colors);
    }

    /** Averages four pixels for each new one, whatever the scale, as the platform's filter does. */
    public void drawBitmap(Bitmap source, Rect part, Rect whole, Paint paint) {
        if (source.isRecycled()) throw new IllegalStateException("recycled");
        if (source.getConfig() == Bitmap.Config.HARDWARE) throw new IllegalArgumentException("hardware");
        int[] colors = new int[whole.width() * whole.height()];
        for (int i = 0; i < colors.length; ++i) {
            int x = i % whole.width() * part.width() / whole.width();
            int y = i / whole.width() * part.height() / whole.height();
            for (int shift = 0; shift < 32; shift += 8) {
                int sum = 2;
                for (int at = 0; at < 4; ++at) {
                    int column = part.left + Math.min(x + at % 2, part.width() - 1);
                    int row = part.top + Math.min(y + at / 2, part.height() - 1);
                    sum += source.color(column, row) >>> shift & 255;
                }
                colors[i] |= sum / 4 << shift;
            }
        }
        target.fill(colors);
    }
}
