package com.zor.android.visualeffect.tidemark.sample;

import android.app.Activity;
import android.content.Intent;
import android.net.Uri;
import android.os.Bundle;
import android.widget.CompoundButton;
import android.widget.Toast;

import com.zor.android.visualeffect.tidemark.TidemarkListener;
import com.zor.android.visualeffect.tidemark.TidemarkView;

/** Water over a tiled pool or a picture of the user's choice, with switches. */
public final class MainActivity extends Activity {
    private TidemarkView water;
    private CompoundButton ink;
    private CompoundButton rain;

    @Override
    protected void onCreate(Bundle savedState) {
        super.onCreate(savedState);
        setContentView(R.layout.main);
        water = findViewById(R.id.water);
        ink = findViewById(R.id.ink);
        rain = findViewById(R.id.rain);
        ink.setOnCheckedChangeListener((button, checked) -> water.setInk(checked));
        rain.setOnCheckedChangeListener((button, checked) -> water.setRain(checked));
        findViewById(R.id.clear).setOnClickListener(button -> water.clearInk());
        findViewById(R.id.picture).setOnClickListener(button -> PicturePicker.open(this));
        water.setListener(new TidemarkListener() {
            @Override
            public void onFailure(Failure failure, String message) {
                int text = failure == Failure.PICTURE ? R.string.unreadable : R.string.no_water;
                Toast.makeText(MainActivity.this, text, Toast.LENGTH_LONG).show();
            }
        });
    }

    // The water has restored its state before this call.
    @Override
    protected void onPostCreate(Bundle savedState) {
        super.onPostCreate(savedState);
        ink.setChecked(water.getInk());
        rain.setChecked(water.getRain() > 0);
    }

    @Override
    protected void onActivityResult(int request, int result, Intent data) {
        super.onActivityResult(request, result, data);
        Uri picture = PicturePicker.chosen(this, request, result, data);
        if (picture != null) water.setPicture(picture);
    }
}
