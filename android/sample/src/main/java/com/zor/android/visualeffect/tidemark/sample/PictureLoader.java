package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.ActivityNotFoundException;
import android.content.ContentResolver;
import android.content.Intent;
import android.graphics.Bitmap;
import android.graphics.BitmapFactory;
import android.graphics.Matrix;
import android.media.ExifInterface;
import android.net.Uri;
import android.os.Build;
import android.widget.Toast;

import java.io.FileNotFoundException;
import java.io.IOException;
import java.io.InputStream;

/**
 * Lets the user choose a picture, and reads it: four bytes a pixel, upright, and small enough for a texture of every
 * device.
 */
final class PictureLoader {
    private static final int LONGEST_SIDE = 2048;

    private PictureLoader() {}

    /** The activity hears of it in {@code onActivityResult}. */
    static void choose(Activity activity, int request) {
        Intent pick = new Intent(Intent.ACTION_OPEN_DOCUMENT);
        pick.addCategory(Intent.CATEGORY_OPENABLE);
        pick.setType("image/*");
        try {
            activity.startActivityForResult(pick, request);
        } catch (ActivityNotFoundException e) {
            Toast.makeText(activity, R.string.no_picker, Toast.LENGTH_LONG).show();
        }
    }

    static Bitmap load(ContentResolver resolver, Uri uri) throws IOException {
        BitmapFactory.Options options = new BitmapFactory.Options();
        options.inJustDecodeBounds = true;
        decode(resolver, uri, options);
        options.inJustDecodeBounds = false;
        options.inPreferredConfig = Bitmap.Config.ARGB_8888;
        // The decoder takes powers of two, and may round a side up.
        int longest = Math.max(options.outWidth, options.outHeight);
        options.inSampleSize = 1;
        while ((longest + options.inSampleSize - 1) / options.inSampleSize > LONGEST_SIDE) {
            options.inSampleSize *= 2;
        }
        Bitmap picture = decode(resolver, uri, options);
        if (picture == null) throw new IOException("not a picture: " + uri);
        return upright(picture, orientation(resolver, uri));
    }

    private static Bitmap decode(ContentResolver resolver, Uri uri, BitmapFactory.Options options) throws IOException {
        try (InputStream stream = open(resolver, uri)) {
            return BitmapFactory.decodeStream(stream, null, options);
        }
    }

    // Cameras store a picture as the sensor saw it and note how it was held.
    private static int orientation(ContentResolver resolver, Uri uri) throws IOException {
        if (Build.VERSION.SDK_INT < Build.VERSION_CODES.N) return ExifInterface.ORIENTATION_NORMAL;
        try (InputStream stream = open(resolver, uri)) {
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

    private static InputStream open(ContentResolver resolver, Uri uri) throws IOException {
        InputStream stream = resolver.openInputStream(uri);
        if (stream == null) throw new FileNotFoundException(uri.toString());
        return stream;
    }
}
