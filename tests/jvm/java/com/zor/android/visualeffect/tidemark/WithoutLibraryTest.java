package com.zor.android.visualeffect.tidemark;

import static org.junit.Assert.assertEquals;
import static org.junit.Assert.assertFalse;
import static org.junit.Assert.assertNull;

import android.graphics.SurfaceTexture;
import android.view.Surface;

import org.junit.Test;

import java.util.ArrayList;
import java.util.List;

/** A view without the native library, as in an app's own tests on a desktop. */
public final class WithoutLibraryTest {
    @Test
    public void onlyTheFirstSurfaceNeedsTheLibrary() {
        List<String> failures = new ArrayList<>();
        TidemarkView view = new TidemarkView(new TestActivity());
        view.setInk(true);
        view.drop(1, 2);
        assertNull(view.toBitmap());
        Screen.settle();
        view.drawOn(new Surface((SurfaceTexture) null), 90, 160);
        view.setPicture(1);
        assertFalse("frames", Screen.refreshUntilFrame());
        view.setListener(new TidemarkListener() {
            @Override
            public void onFailure(Failure failure, String message) {
                failures.add(failure.name());
            }
        });
        assertEquals(List.of("NO_LIBRARY"), failures);
    }
}
