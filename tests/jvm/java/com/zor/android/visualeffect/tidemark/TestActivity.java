package com.zor.android.visualeffect.tidemark;

import android.app.Activity;
import android.content.res.Resources;
import android.util.DisplayMetrics;

import java.io.ByteArrayInputStream;
import java.io.InputStream;
import java.nio.ByteBuffer;

// Its display has two pixels for a density-independent one. The number of a resource is the colour of its picture.
final class TestActivity extends Activity {
    static final int NO_PICTURE = 0x10203;

    @Override
    public Resources getResources() {
        return new Resources(null, null, null) {
            @Override
            public DisplayMetrics getDisplayMetrics() {
                DisplayMetrics display = new DisplayMetrics();
                display.density = 2;
                display.widthPixels = display.heightPixels = 160;
                return display;
            }

            @Override
            public InputStream openRawResource(int resource) {
                int color = resource == R.drawable.tidemark_light ? 0xffffffff : resource;
                byte[] file = ByteBuffer.allocate(4).putInt(color).array();
                return new ByteArrayInputStream(file, 0, resource == NO_PICTURE ? 0 : 4);
            }
        };
    }
}
