package com.zor.android.visualeffect.tidemark.sample;

import android.content.ContentResolver;
import android.graphics.Bitmap;
import android.graphics.BitmapFactory;
import android.graphics.Matrix;
import android.media.ExifInterface;
import android.net.Uri;
import android.os.Build;

import java.io.FileNotFoundException;
import java.io.IOException;
import java.io.InputStream;

/** Reads a picture of the user's: four bytes a pixel, upright, and small enough for a texture of every device. */
final class PictureLoader {
    private static final int LONGEST_SIDE = 2048;

    private PictureLoader() {}

    static Bitmap load(ContentResolver resolver, Uri uri) throws IOException {
        BitmapFactory.Options options = new BitmapFactory.Options();
        options.inJustDecodeBounds = true;
        decode(resolver, uri, options);
        options.inJustDecodeBounds = false;
        options.inPreferredConfig = Bitmap.Config.ARGB_8888;
        // The decoder rounds the divisor down to a power of two.
        options.inSampleSize = 1;
        while (Math.max(options.outWidth, options.outHeight) / options.inSampleSize > LONGEST_SIDE) {
            options.inSampleSize *= 2;
        }
        Bitmap picture = decode(resolver, uri, options);
        if (picture == null) throw new IOException("not a picture: " + uri);
        return turn(picture, degrees(resolver, uri));
    }

    private static Bitmap decode(ContentResolver resolver, Uri uri, BitmapFactory.Options options) throws IOException {
        try (InputStream stream = open(resolver, uri)) {
            return BitmapFactory.decodeStream(stream, null, options);
        }
    }

    // Cameras store a picture as the sensor saw it and note how it was held.
    private static int degrees(ContentResolver resolver, Uri uri) throws IOException {
        if (Build.VERSION.SDK_INT < Build.VERSION_CODES.N) return 0;
        try (InputStream stream = open(resolver, uri)) {
            ExifInterface exif = new ExifInterface(stream);
            switch (exif.getAttributeInt(ExifInterface.TAG_ORIENTATION, ExifInterface.ORIENTATION_NORMAL)) {
                case ExifInterface.ORIENTATION_ROTATE_90:
                    return 90;
                case ExifInterface.ORIENTATION_ROTATE_180:
                    return 180;
                case ExifInterface.ORIENTATION_ROTATE_270:
                    return 270;
                default:
                    return 0;
            }
        }
    }

    private static Bitmap turn(Bitmap picture, int degrees) {
        if (degrees == 0) return picture;
        Matrix matrix = new Matrix();
        matrix.postRotate(degrees);
        return Bitmap.createBitmap(picture, 0, 0, picture.getWidth(), picture.getHeight(), matrix, true);
    }

    private static InputStream open(ContentResolver resolver, Uri uri) throws IOException {
        InputStream stream = resolver.openInputStream(uri);
        if (stream == null) throw new FileNotFoundException(uri.toString());
        return stream;
    }
}
