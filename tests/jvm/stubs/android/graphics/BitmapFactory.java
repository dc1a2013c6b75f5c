package android.graphics;

import java.io.InputStream;

public class BitmapFactory {
    public static class Options {
        public boolean inJustDecodeBounds;
        public int inSampleSize;
        public Bitmap.Config inPreferredConfig;
        public int outWidth;
        public int outHeight;
    }

    public static Bitmap decodeStream(InputStream stream, Rect padding, Options options) {
        return null;
    }
}
