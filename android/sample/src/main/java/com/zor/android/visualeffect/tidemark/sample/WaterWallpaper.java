package com.zor.android.visualeffect.tidemark.sample;

import android.content.SharedPreferences;
import android.graphics.Bitmap;
import android.net.Uri;
import android.os.Handler;
import android.os.Looper;
import android.service.wallpaper.WallpaperService;
import android.util.Log;
import android.view.MotionEvent;
import android.view.SurfaceHolder;

import com.zor.android.visualeffect.tidemark.TidemarkView;

import java.io.IOException;

/** Water as a live wallpaper. Of the wallpaper and its preview the one that was shown last draws. */
public final class WaterWallpaper extends WallpaperService {
    @Override
    public Engine onCreateEngine() {
        return new WaterEngine();
    }

    private final class WaterEngine extends Engine implements SharedPreferences.OnSharedPreferenceChangeListener {
        /** In no window: it draws on the wallpaper's surface. */
        private final class Water extends TidemarkView {
            Water() {
                super(WaterWallpaper.this);
            }

            @Override
            public SurfaceHolder getHolder() {
                return getSurfaceHolder();
            }

            void end() {
                onDetachedFromWindow();
            }
        }

        private final SharedPreferences settings = WallpaperSettings.of(WaterWallpaper.this);
        private Water water;

        @Override
        public void onCreate(SurfaceHolder holder) {
            super.onCreate(holder);
            water = new Water();
            setTouchEventsEnabled(true);
            settings.registerOnSharedPreferenceChangeListener(this);
            onSharedPreferenceChanged(settings, WallpaperSettings.PICTURE);
        }

        @Override
        public void onVisibilityChanged(boolean visible) {
            if (visible) {
                water.onStart();
            } else {
                water.onStop();
            }
        }

        @Override
        public void onTouchEvent(MotionEvent event) {
            water.onTouchEvent(event);
        }

        @Override
        public void onDestroy() {
            settings.unregisterOnSharedPreferenceChangeListener(this);
            water.end();
            super.onDestroy();
        }

        @Override
        public void onSharedPreferenceChanged(SharedPreferences changed, String key) {
            water.setInk(settings.getBoolean(WallpaperSettings.INK, false));
            water.setRain(settings.getBoolean(WallpaperSettings.RAIN, false));
            if (WallpaperSettings.PICTURE.equals(key)) new Thread(this::showPicture).start();
        }

        // Takes up to a second.
        private void showPicture() {
            String address = settings.getString(WallpaperSettings.PICTURE, null);
            Bitmap chosen = address == null ? null : load(Uri.parse(address));
            Bitmap portrait = chosen != null ? chosen : SamplePictures.sand(480, 854);
            Bitmap landscape = chosen != null ? chosen : SamplePictures.sand(854, 480);
            Bitmap light = SamplePictures.light(256);
            new Handler(Looper.getMainLooper()).post(() -> water.setPictures(portrait, landscape, light));
        }

        // Null where the picture is gone.
        private Bitmap load(Uri uri) {
            try {
                return PictureLoader.load(getContentResolver(), uri);
            } catch (IOException | SecurityException e) {
                Log.w("Tidemark", "the wallpaper's picture cannot be read", e);
                return null;
            }
        }
    }
}
