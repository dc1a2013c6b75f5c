package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.ActivityNotFoundException;
import android.content.ContentResolver;
import android.content.Intent;
import android.content.UriPermission;
import android.net.Uri;
import android.widget.Toast;

/** Lets the user choose a picture, which the app may read from then on. */
final class PicturePicker {
    private static final int REQUEST = 1;
    private static final int READ = Intent.FLAG_GRANT_READ_URI_PERMISSION;

    private PicturePicker() {}

    /** The activity hears of it in {@code onActivityResult}. */
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

    /** Null where none was chosen. */
    static Uri chosen(Activity activity, int request, int result, Intent data) {
        if (request != REQUEST || result != Activity.RESULT_OK || data == null) return null;
        Uri picture = data.getData();
        ContentResolver resolver = activity.getContentResolver();
        Uri wallpaper = WallpaperSettings.picture(activity);
        // An app may hold a few hundred permissions only.
        for (UriPermission held : resolver.getPersistedUriPermissions()) {
            if (!held.getUri().equals(wallpaper)) resolver.releasePersistableUriPermission(held.getUri(), READ);
        }
        resolver.takePersistableUriPermission(picture, READ);
        return picture;
    }
}
