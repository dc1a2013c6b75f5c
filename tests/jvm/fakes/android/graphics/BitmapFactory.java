package android.graphics;

import java.io.DataInputStream;
import java.io.IOException;
import java.io.InputStream;
import java.util.Arrays;

/** Decodes files that contain a colour, as a number, into bitmaps of that colour. */
public class BitmapFactory {
    public static class Options {
        public boolean inJustDecodeBounds;
        public int inSampleSize;
        public Bitmap.Config inPreferredConfig;
        public int outWidth = 40, outHeight = 40;
    }

    public static Bitmap decodeStream(InputStream stream, Rect padding, Options options) {
        int[] colors = new int[40 * 40];
        try {
            Arrays.fill(colors, new DataInputStream(stream).readInt());
        } catch (IOException e) {
            return null;
        }
        return Bitmap.createBitmap(colors, 40, 40, options.inPreferredConfig);
    }
}
