package com.zor.android.visualeffect.tidemark;

import android.content.res.Resources;
import android.content.res.TypedArray;
import android.widget.ImageView;

import java.io.IOException;
import java.io.InputStream;

/** The attributes of a {@link TidemarkView} in a layout. */
final class ViewAttributes {
    private ViewAttributes() {}

    static void apply(TypedArray values, TidemarkView view) {
        int preset = values.getInt(R.styleable.TidemarkView_tidemarkPreset, -1);
        if (preset >= 0) view.setPreset(Preset.values()[preset]);
        int look = values.getResourceId(R.styleable.TidemarkView_tidemarkLook, 0);
        if (look != 0) view.setLook(read(values.getResources(), look));
        if (values.hasValue(R.styleable.TidemarkView_tidemarkInkColor)) {
            view.setInkColor(values.getColor(R.styleable.TidemarkView_tidemarkInkColor, 0));
        }
        view.setInk(values.getBoolean(R.styleable.TidemarkView_tidemarkInk, view.getInk()));
        view.setRain(values.getFloat(R.styleable.TidemarkView_tidemarkRain, view.getRain()));
        view.setBreezeAlways(values.getInt(R.styleable.TidemarkView_tidemarkBreeze, 0) != 0);
        view.setFirstDrop(values.getBoolean(R.styleable.TidemarkView_tidemarkFirstDrop, false));
        view.setQuality(Quality.values()[values.getInt(R.styleable.TidemarkView_tidemarkQuality, 0)]);
        view.setInteraction(Interaction.values()[values.getInt(R.styleable.TidemarkView_tidemarkInteraction, 0)]);
        view.setMotion(Motion.values()[values.getInt(R.styleable.TidemarkView_tidemarkMotion, 0)]);
        int picture = values.getResourceId(R.styleable.TidemarkView_tidemarkPicture, 0);
        int portrait = values.getResourceId(R.styleable.TidemarkView_tidemarkPortrait, picture);
        int landscape = values.getResourceId(R.styleable.TidemarkView_tidemarkLandscape, picture);
        if (portrait == 0 && landscape == 0) return;
        if (view.isInEditMode()) {
            showStill(portrait != 0 ? portrait : landscape, view);
        } else {
            view.setPictures(portrait, landscape, values.getResourceId(R.styleable.TidemarkView_tidemarkLight, 0));
        }
    }

    // A layout editor has no native library.
    private static void showStill(int picture, TidemarkView view) {
        ImageView still = new ImageView(view.getContext());
        still.setScaleType(ImageView.ScaleType.CENTER_CROP);
        still.setImageResource(picture);
        view.addView(still, 0);
    }

    private static Look read(Resources resources, int look) {
        try (InputStream text = resources.openRawResource(look)) {
            return Look.load(text);
        } catch (IOException e) {
            throw new IllegalArgumentException("cannot read app:tidemarkLook", e);
        }
    }
}
