package android.graphics;

/** Draws whole pictures. */
public class Canvas {
    private final Bitmap target;

    public Canvas(Bitmap target) {
        this.target = target;
    }

    /** As the platform's filter, which takes four pixels for one, however many there are. */
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
