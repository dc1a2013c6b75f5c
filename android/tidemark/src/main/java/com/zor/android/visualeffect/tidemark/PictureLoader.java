package com.zor.android.visualeffect.tidemark;

import android.content.Context;
import android.graphics.Bitmap;
import android.graphics.BitmapFactory;
import android.graphics.Matrix;
import android.media.ExifInterface;
import android.net.Uri;
import android.os.Build;

import java.io.FileNotFoundException;
import java.io.IOException;
import java.io.InputStream;
import java.util.concurrent.ExecutorService;
import java.util.concurrent.LinkedBlockingQueue;
import java.util.concurrent.ThreadPoolExecutor;
import java.util.concurrent.TimeUnit;

/** Decodes pictures on a thread of its own, upright and with about as many pixels as the display can show. */
final class PictureLoader {
    private static final int MOST_PIXELS = 12000000;

    // For EXIF's orientations from 1 on: clockwise degrees, and after the rotation the factor on x.
    private static final int[][] TURNS =
            {{0, 1}, {0, -1}, {180, 1}, {180, -1}, {90, -1}, {90, 1}, {270, -1}, {270, 1}};

    // The thread ends after five idle seconds.
    private static final ExecutorService THREAD =
            new ThreadPoolExecutor(0, 1, 5, TimeUnit.SECONDS, new LinkedBlockingQueue<>());

    private PictureLoader() {}

    static void post(Runnable call) {
        THREAD.execute(call);
    }

    /**
     * Returns the picture of the number of a resource or of a {@code Uri}; a {@code Bitmap} is returned as it is.
     *
     * @param leastSide pixels that the shorter side keeps when a large picture is reduced
     */
    static Bitmap load(Context context, Object source, int leastSide) throws IOException {
        if (source instanceof Bitmap) return (Bitmap) source;
        BitmapFactory.Options options = new BitmapFactory.Options();
        options.inJustDecodeBounds = true;
        decode(context, source, options);
        options.inJustDecodeBounds = false;
        options.inPreferredConfig = Bitmap.Config.ARGB_8888;
        options.inSampleSize = samples(options.outWidth, options.outHeight, leastSide);
        Bitmap picture = decode(context, source, options);
        if (picture == null) throw new IOException("cannot decode " + source + " as a picture");
        return upright(picture, orientation(context, source));
    }

    /**
     * Returns the divisor of both sides, a power of two. The shorter side keeps {@code leastSide} pixels, because the
     * longer side of a view may be along it; very large pictures keep less.
     */
    static int samples(int width, int height, int leastSide) {
        int samples = 1;
        while (Math.min(width, height) / (2 * samples) >= leastSide
                || (double) width * height / samples / samples > MOST_PIXELS) {
            samples *= 2;
        }
        return samples;
    }

    private static Bitmap decode(Context context, Object source, BitmapFactory.Options options) throws IOException {
        try (InputStream stream = open(context, source)) {
            return BitmapFactory.decodeStream(stream, null, options);
        }
    }

    private static InputStream open(Context context, Object source) throws IOException {
        if (source instanceof Integer) return context.getResources().openRawResource((Integer) source);
        InputStream stream = context.getContentResolver().openInputStream((Uri) source);
        if (stream == null) throw new FileNotFoundException(source.toString());
        return stream;
    }

    // Cameras store a picture as the sensor has it, with the orientation of the camera.
    private static int orientation(Context context, Object source) throws IOException {
        if (Build.VERSION.SDK_INT < Build.VERSION_CODES.N) return ExifInterface.ORIENTATION_NORMAL;
        try (InputStream stream = open(context, source)) {
            return new ExifInterface(stream)
                    .getAttributeInt(ExifInterface.TAG_ORIENTATION, ExifInterface.ORIENTATION_NORMAL);
        }
    }

    /** Turns and mirrors a picture as an EXIF orientation says. */
    static Bitmap upright(Bitmap picture, int orientation) {
        if (orientation <= ExifInterface.ORIENTATION_NORMAL || orientation > TURNS.length) return picture;
        Matrix matrix = new Matrix();
        matrix.postRotate(TURNS[orientation - 1][0]);
        matrix.postScale(TURNS[orientation - 1][1], 1);
        return Bitmap.createBitmap(picture, 0, 0, picture.getWidth(), picture.getHeight(), matrix, true);
    }
}
