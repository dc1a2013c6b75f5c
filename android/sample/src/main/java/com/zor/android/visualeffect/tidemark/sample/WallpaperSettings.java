package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.Context;
import android.content.Intent;
import android.content.SharedPreferences;
import android.net.Uri;
import android.os.Bundle;
import android.widget.CompoundButton;

/** The settings of the wallpaper: picture, ink and rain. A change takes effect at once. */
public final class WallpaperSettings extends Activity {
    static final String INK = "ink";
    static final String RAIN = "rain";
    private static final String PICTURE = "picture";

    static SharedPreferences of(Context context) {
        return context.getSharedPreferences("wallpaper", MODE_PRIVATE);
    }

    /** Returns the user's picture, or null for the pool. */
    static Uri picture(Context context) {
        String address = of(context).getString(PICTURE, null);
        return address == null ? null : Uri.parse(address);
    }

    @Override
    protected void onCreate(Bundle savedState) {
        super.onCreate(savedState);
        setContentView(R.layout.settings);
        bind(R.id.ink, INK);
        bind(R.id.rain, RAIN);
        findViewById(R.id.picture).setOnClickListener(button -> PicturePicker.open(this));
    }

    private void bind(int id, String key) {
        CompoundButton button = findViewById(id);
        button.setChecked(of(this).getBoolean(key, false));
        button.setOnCheckedChangeListener((changed, checked) -> of(this).edit().putBoolean(key, checked).apply());
    }

    @Override
    protected void onActivityResult(int request, int result, Intent data) {
        super.onActivityResult(request, result, data);
        Uri picture = PicturePicker.chosen(this, request, result, data);
        if (picture != null) of(this).edit().putString(PICTURE, picture.toString()).apply();
    }
}
