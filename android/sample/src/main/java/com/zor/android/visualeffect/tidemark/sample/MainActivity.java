package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.Intent;
import android.graphics.Bitmap;
import android.net.Uri;
import android.os.Bundle;
import android.widget.Button;
import android.widget.CompoundButton;
import android.widget.Toast;

import com.zor.android.visualeffect.tidemark.TidemarkView;

import java.io.IOException;

/** Water over a picture of the user's choice, with an ink switch. */
public final class MainActivity extends Activity {
    private static final int PICK_PICTURE = 1;

    private Bitmap light;  // once the sand is shown
    private TidemarkView water;

    @Override
    protected void onCreate(Bundle savedState) {
        super.onCreate(savedState);
        setContentView(R.layout.main);
        water = findViewById(R.id.water);
        water.followLifecycle(this);
        new Thread(this::showSand).start();

        CompoundButton ink = findViewById(R.id.ink);
        ink.setOnCheckedChangeListener((button, checked) -> water.setInk(checked));
        CompoundButton rain = findViewById(R.id.rain);
        rain.setOnCheckedChangeListener((button, checked) -> water.setRain(checked));
        Button clear = findViewById(R.id.clear);
        clear.setOnClickListener(button -> water.clearInk());
        Button picture = findViewById(R.id.picture);
        picture.setOnClickListener(button -> {
            if (light != null) PictureLoader.choose(this, PICK_PICTURE);
        });
    }

    // Takes up to a second.
    private void showSand() {
        Bitmap portrait = SamplePictures.sand(480, 854);
        Bitmap landscape = SamplePictures.sand(854, 480);
        Bitmap net = SamplePictures.light(256);
        runOnUiThread(() -> {
            light = net;
            water.setPictures(portrait, landscape, light);
        });
    }

    @Override
    protected void onActivityResult(int request, int result, Intent data) {
        super.onActivityResult(request, result, data);
        if (request != PICK_PICTURE || result != RESULT_OK || data == null) return;
        Uri uri = data.getData();
        new Thread(() -> showPicture(uri)).start();
    }

    private void showPicture(Uri uri) {
        try {
            Bitmap picture = PictureLoader.load(getContentResolver(), uri);
            runOnUiThread(() -> {
                if (light != null) water.setPictures(picture, picture, light);
            });
        } catch (IOException | SecurityException e) {
            runOnUiThread(() -> Toast.makeText(this, R.string.unreadable, Toast.LENGTH_LONG).show());
        }
    }
}
