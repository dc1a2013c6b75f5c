package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.Context;
import android.content.Intent;
import android.content.SharedPreferences;
import android.net.Uri;
import android.os.Bundle;
import android.widget.Button;
import android.widget.CompoundButton;

/** Picture, ink and rain of the wallpaper, which follows at once. */
public final class WallpaperSettings extends Activity {
    /** The address of the user's picture; none for the sand. */
    static final String PICTURE = "picture";

    static final String INK = "ink";
    static final String RAIN = "rain";
    private static final int PICK_PICTURE = 1;

    static SharedPreferences of(Context context) {
        return context.getSharedPreferences("wallpaper", MODE_PRIVATE);
    }

    @Override
    protected void onCreate(Bundle savedState) {
        super.onCreate(savedState);
        setContentView(R.layout.settings);
        bind(R.id.ink, INK);
        bind(R.id.rain, RAIN);
        Button picture = findViewById(R.id.picture);
        picture.setOnClickListener(button -> PictureLoader.choose(this, PICK_PICTURE));
    }

    private void bind(int id, String key) {
        CompoundButton button = findViewById(id);
        button.setChecked(of(this).getBoolean(key, false));
        button.setOnCheckedChangeListener((changed, checked) -> of(this).edit().putBoolean(key, checked).apply());
    }

    @Override
    protected void onActivityResult(int request, int result, Intent data) {
        super.onActivityResult(request, result, data);
        if (request != PICK_PICTURE || result != RESULT_OK || data == null) return;
        Uri uri = data.getData();
        // The wallpaper reads it long after this activity.
        getContentResolver().takePersistableUriPermission(uri, Intent.FLAG_GRANT_READ_URI_PERMISSION);
        of(this).edit().putString(PICTURE, uri.toString()).apply();
    }
}
