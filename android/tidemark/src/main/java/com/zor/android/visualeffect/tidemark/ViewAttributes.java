package com.zor.android.visualeffect.tidemark;

import android.content.res.Resources;
import android.content.res.TypedArray;
import android.graphics.Bitmap;
import android.graphics.BitmapFactory;

import java.io.IOException;
import java.io.InputStream;

/** What a layout says about a {@link TidemarkView}. */
final class ViewAttributes {
    private ViewAttributes() {}

    static void apply(TypedArray given, TidemarkView view) {
        Resources resources = given.getResources();
        int look = given.getResourceId(R.styleable.TidemarkView_look, 0);
        if (look != 0) view.setLook(read(resources, look));
        int portrait = given.getResourceId(R.styleable.TidemarkView_portrait, 0);
        int landscape = given.getResourceId(R.styleable.TidemarkView_landscape, portrait);
        if (landscape != 0) {
            Bitmap upright = decode(resources, portrait);
            Bitmap wide = landscape == portrait ? upright : decode(resources, landscape);
            int light = given.getResourceId(R.styleable.TidemarkView_light, 0);
            view.setPictures(upright, wide, decode(resources, light));
        }
        view.setInk(given.getBoolean(R.styleable.TidemarkView_ink, false));
        view.setQuality(Quality.values()[given.getInt(R.styleable.TidemarkView_quality, 0)]);
        view.setRain(given.getBoolean(R.styleable.TidemarkView_rain, false));
    }

    private static Look read(Resources resources, int look) {
        try (InputStream text = resources.openRawResource(look)) {
            return Look.load(text);
        } catch (IOException e) {
            throw new IllegalArgumentException("app:look cannot be read", e);
        }
    }

    // Pixel by pixel, whatever the density; null for what is no bitmap.
    private static Bitmap decode(Resources resources, int picture) {
        BitmapFactory.Options options = new BitmapFactory.Options();
        options.inScaled = false;
        return picture == 0 ? null : BitmapFactory.decodeResource(resources, picture, options);
    }
}
