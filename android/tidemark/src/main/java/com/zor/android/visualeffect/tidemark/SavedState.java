package com.zor.android.visualeffect.tidemark;

import android.net.Uri;
import android.os.Bundle;
import android.os.Parcelable;

/** The part of a view's state that is saved with its activity: ink, rain, and pictures that can be loaded again. */
final class SavedState {
    private static final String SUPERCLASS = "superclass";
    private static final String PICTURE = "picture";  // and the place among the sources
    private static final String INK = "ink";
    private static final String RAIN = "rain";

    private SavedState() {}

    static Parcelable save(TidemarkView view, Parcelable ofSuperclass, Object[] sources) {
        Bundle state = new Bundle();
        state.putParcelable(SUPERCLASS, ofSuperclass);
        for (int i = 0; i < sources.length; ++i) {
            if (sources[i] instanceof Integer) state.putInt(PICTURE + i, (Integer) sources[i]);
            if (sources[i] instanceof Uri) state.putParcelable(PICTURE + i, (Uri) sources[i]);
        }
        state.putBoolean(INK, view.getInk());
        state.putFloat(RAIN, view.getRain());
        return state;
    }

    static Parcelable ofSuperclass(Parcelable saved) {
        Bundle state = (Bundle) saved;
        state.setClassLoader(TidemarkView.class.getClassLoader());
        return state.getParcelable(SUPERCLASS);
    }

    static void restore(Parcelable saved, TidemarkView view, PictureRequests pictures) {
        Bundle state = (Bundle) saved;
        Object[] sources = new Object[3];
        for (int i = 0; i < sources.length; ++i) sources[i] = state.get(PICTURE + i);
        if (sources[0] != null || sources[1] != null) pictures.request(sources[0], sources[1], sources[2]);
        view.setInk(state.getBoolean(INK));
        view.setRain(state.getFloat(RAIN));
    }
}
