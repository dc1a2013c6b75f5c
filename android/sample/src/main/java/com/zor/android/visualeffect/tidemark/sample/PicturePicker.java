package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.ActivityNotFoundException;
import android.content.ContentResolver;
import android.content.Intent;
import android.content.UriPermission;
import android.net.Uri;
import android.widget.Toast;

/** Lets the user choose a picture, and keeps the permission to read it. */
final class PicturePicker {
    private static final int REQUEST = 1;
    private static final int READ = Intent.FLAG_GRANT_READ_URI_PERMISSION;

    private PicturePicker() {}

    /** Opens the system's picker. The activity gets the result in {@code onActivityResult}. */
    static void open(Activity activity) {
        Intent pick = new Intent(Intent.ACTION_OPEN_DOCUMENT);
        pick.addCategory(Intent.CATEGORY_OPENABLE);
        pick.setType("image/*");
        try {
            activity.startActivityForResult(pick, REQUEST);
        } catch (ActivityNotFoundException e) {
            Toast.makeText(activity, R.string.no_picker, Toast.LENGTH_LONG).show();
        }
    }

    /** Returns the chosen picture, or null if the user has chosen none. */
    static Uri chosen(Activity activity, int request, int result, Intent data) {
        if (request != REQUEST || result != Activity.RESULT_OK || data == null) return null;
        Uri picture = data.getData();
        ContentResolver resolver = activity.getContentResolver();
        Uri wallpaper = WallpaperSettings.picture(activity);
        // The system limits the number of permissions, so release all that are no longer used.
        for (UriPermission old : resolver.getPersistedUriPermissions()) {
            if (!old.getUri().equals(wallpaper)) resolver.releasePersistableUriPermission(old.getUri(), READ);
        }
        resolver.takePersistableUriPermission(picture, READ);
        return picture;
    }
}
