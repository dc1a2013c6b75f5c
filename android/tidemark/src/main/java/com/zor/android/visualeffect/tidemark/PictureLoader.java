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

/** Decodes pictures, with as many pixels as the display can show, upright, on a thread of its own. */
final class PictureLoader {
    private static final int MOST_PIXELS = 12000000;

    // A thread while there is something to do.
    private static final ExecutorService THREAD =
            new ThreadPoolExecutor(0, 1, 5, TimeUnit.SECONDS, new LinkedBlockingQueue<>());

    private PictureLoader() {}

    static void post(Runnable call) {
        THREAD.execute(call);
    }

    /** Of a {@code Bitmap}, which comes back as it is, the number of a resource, or a {@code Uri}. */
    static Bitmap load(Context context, Object source, int leastSide) throws IOException {
        if (source instanceof Bitmap) return (Bitmap) source;
        BitmapFactory.Options options = new BitmapFactory.Options();
        options.inJustDecodeBounds = true;
        decode(context, source, options);
        options.inJustDecodeBounds = false;
        options.inPreferredConfig = Bitmap.Config.ARGB_8888;
        options.inSampleSize = samples(options.outWidth, options.outHeight, leastSide);
        Bitmap picture = decode(context, source, options);
        if (picture == null) throw new IOException("not a picture: " + source);
        return upright(picture, orientation(context, source));
    }

    /** Of each side one pixel in so many, a power of two: the shorter side, along which a view may lie, keeps enough. */
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

    // Cameras store a picture as the sensor saw it and note how it was held.
    private static int orientation(Context context, Object source) throws IOException {
        if (Build.VERSION.SDK_INT < Build.VERSION_CODES.N) return ExifInterface.ORIENTATION_NORMAL;
        try (InputStream stream = open(context, source)) {
            return new ExifInterface(stream)
                    .getAttributeInt(ExifInterface.TAG_ORIENTATION, ExifInterface.ORIENTATION_NORMAL);
        }
    }

    private static Bitmap upright(Bitmap picture, int orientation) {
        Matrix matrix = new Matrix();
        switch (orientation) {
            case ExifInterface.ORIENTATION_FLIP_HORIZONTAL:
                matrix.postScale(-1, 1);
                break;
            case ExifInterface.ORIENTATION_ROTATE_180:
                matrix.postRotate(180);
                break;
            case ExifInterface.ORIENTATION_FLIP_VERTICAL:
                matrix.postScale(1, -1);
                break;
            case ExifInterface.ORIENTATION_TRANSPOSE:
                matrix.postRotate(90);
                matrix.postScale(-1, 1);
                break;
            case ExifInterface.ORIENTATION_ROTATE_90:
                matrix.postRotate(90);
                break;
            case ExifInterface.ORIENTATION_TRANSVERSE:
                matrix.postRotate(270);
                matrix.postScale(-1, 1);
                break;
            case ExifInterface.ORIENTATION_ROTATE_270:
                matrix.postRotate(270);
                break;
            default:
                return picture;
        }
        return Bitmap.createBitmap(picture, 0, 0, picture.getWidth(), picture.getHeight(), matrix, true);
    }
}
