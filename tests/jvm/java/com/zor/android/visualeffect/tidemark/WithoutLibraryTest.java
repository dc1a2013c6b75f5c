package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;

import android.app.Activity;

import org.junit.Test;

import java.util.ArrayList;
import java.util.List;

/** Where the native library is missing, as in a layout editor and in an app's own tests on a desktop. */
public final class WithoutLibraryTest {
    @Test
    public void onlyTheFirstSurfaceMissesTheLibrary() {
        List<String> heard = new ArrayList<>();
        TidemarkView view = new TidemarkView(new Activity());
        view.setListener(new TidemarkListener() {
            @Override
            public void onFailure(Failure failure, String message) {
                heard.add(failure.name());
            }
        });
        view.setInk(true);
        view.ripple(1, 2, 1);
        view.onStart();
        assertEquals(List.of(), heard);
        view.renderer.onSurfaceCreated(null, null);
        view.renderer.onSurfaceChanged(null, 90, 160);
        view.renderer.onDrawFrame(null);
        assertEquals(List.of("NO_LIBRARY"), heard);
    }
}
