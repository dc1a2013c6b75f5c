package com.zor.android.visualeffect.tidemark;

import android.content.res.Resources;
import android.content.res.TypedArray;
import android.widget.ImageView;

import java.io.IOException;
import java.io.InputStream;

/** What a layout says about a {@link TidemarkView}. */
final class ViewAttributes {
    private ViewAttributes() {}

    static void apply(TypedArray given, TidemarkView view) {
        int preset = given.getInt(R.styleable.TidemarkView_tidemarkPreset, -1);
        if (preset >= 0) view.setPreset(Preset.values()[preset]);
        int look = given.getResourceId(R.styleable.TidemarkView_tidemarkLook, 0);
        if (look != 0) view.setLook(read(given.getResources(), look));
        if (given.hasValue(R.styleable.TidemarkView_tidemarkInkColor)) {
            view.setInkColor(given.getColor(R.styleable.TidemarkView_tidemarkInkColor, 0));
        }
        view.setInk(given.getBoolean(R.styleable.TidemarkView_tidemarkInk, view.getInk()));
        view.setRain(given.getFloat(R.styleable.TidemarkView_tidemarkRain, view.getRain()));
        view.setBreezeAlways(given.getInt(R.styleable.TidemarkView_tidemarkBreeze, 0) != 0);
        view.setFirstDrop(given.getBoolean(R.styleable.TidemarkView_tidemarkFirstDrop, false));
        view.setQuality(Quality.values()[given.getInt(R.styleable.TidemarkView_tidemarkQuality, 0)]);
        view.setInteraction(Interaction.values()[given.getInt(R.styleable.TidemarkView_tidemarkInteraction, 0)]);
        view.setMotion(Motion.values()[given.getInt(R.styleable.TidemarkView_tidemarkMotion, 0)]);
        int picture = given.getResourceId(R.styleable.TidemarkView_tidemarkPicture, 0);
        int portrait = given.getResourceId(R.styleable.TidemarkView_tidemarkPortrait, picture);
        int landscape = given.getResourceId(R.styleable.TidemarkView_tidemarkLandscape, picture);
        if (portrait == 0 && landscape == 0) return;
        if (view.isInEditMode()) {
            show(portrait != 0 ? portrait : landscape, view);
        } else {
            view.setPictures(portrait, landscape, given.getResourceId(R.styleable.TidemarkView_tidemarkLight, 0));
        }
    }

    // A layout editor has no water.
    private static void show(int picture, TidemarkView view) {
        ImageView still = new ImageView(view.getContext());
        still.setScaleType(ImageView.ScaleType.CENTER_CROP);
        still.setImageResource(picture);
        view.addView(still, 0);
    }

    private static Look read(Resources resources, int look) {
        try (InputStream text = resources.openRawResource(look)) {
            return Look.load(text);
        } catch (IOException e) {
            throw new IllegalArgumentException("app:tidemarkLook cannot be read", e);
        }
    }
}
